#include "keyfile/kvf_value.h"

#include <array>
#include <charconv>
#include <stdexcept>

namespace tessal {

namespace {

constexpr int kSignificantDigits = 16;

void Require(bool isType) {
  if (!isType) throw std::runtime_error("Incompatible type!");
}

template <class... Format>
void AppendNumber(std::string& written, Format... number) {
  std::array<char, 32> digits;
  const auto made = std::to_chars(digits.data(), digits.data() + digits.size(), number...);
  written.append(digits.data(), made.ptr);
}

}  // namespace

bool KvfValue::AsBoolean() const {
  Require(tag == kBoolean);
  return boolean;
}

std::int32_t KvfValue::AsInteger() const {
  Require(tag == kInteger);
  return integer;
}

double KvfValue::AsReal() const {
  Require(tag == kReal);
  return real;
}

std::string_view KvfValue::AsString() const {
  Require(IsText());
  return {text, size};
}

void KvfValue::AppendTo(std::string& written) const {
  switch (tag) {
    case kBoolean:
      written += boolean ? "true" : "false";
      break;
    case kInteger:
      AppendNumber(written, integer);
      break;
    case kReal:
      AppendNumber(written, real, std::chars_format::general, kSignificantDigits);
      break;
    case kQuoted:
      written.append("'").append(AsString()).append("'");
      break;
    case kPath:
      written.append("|").append(AsString()).append("|");
      break;
    default:
      written += "illegal type";
      break;
  }
}

bool operator==(const KvfValue& left, const KvfValue& right) {
  if (left.tag != right.tag) return false;
  switch (left.tag) {
    case KvfValue::kBoolean:
      return left.boolean == right.boolean;
    case KvfValue::kInteger:
      return left.integer == right.integer;
    case KvfValue::kReal:
      return left.real == right.real;
    default:
      return left.AsString() == right.AsString();
  }
}

}  // namespace tessal
