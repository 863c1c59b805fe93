#include "keyfile/kvf_value.h"

#include <ios>
#include <ostream>
#include <stdexcept>

namespace tessal {

namespace {

constexpr int kSignificantDigits = 16;

template <class Type, class Content>
const Type& Get(const Content& content) {
  const Type* value = std::get_if<Type>(&content);
  if (value == nullptr) throw std::runtime_error("Incompatible type!");
  return *value;
}

}  // namespace

bool KvfValue::AsBoolean() const {
  return Get<bool>(content);
}

std::int32_t KvfValue::AsInteger() const {
  return Get<std::int32_t>(content);
}

double KvfValue::AsReal() const {
  return Get<double>(content);
}

const std::string& KvfValue::AsString() const {
  return Get<std::string>(content);
}

void KvfValue::Write(std::ostream& stream) const {
  switch (tag) {
    case kBoolean:
      stream << (AsBoolean() ? "true" : "false");
      break;
    case kInteger:
      stream << AsInteger();
      break;
    case kReal: {
      const std::streamsize former = stream.precision(kSignificantDigits);
      stream << AsReal();
      stream.precision(former);
      break;
    }
    case kQuoted:
      stream << '\'' << AsString() << '\'';
      break;
    case kPath:
      stream << '|' << AsString() << '|';
      break;
    default:
      stream << "illegal type";
      break;
  }
}

}  // namespace tessal
