#include "elements/property_io.h"

#include <cmath>

#include "core/error_registry.h"
#include "elements/element.h"
#include "elements/property.h"
#include "expr/scanner.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

constexpr std::string_view kBlanks = " \n\r\t";

std::string& LastKeyErrorText() {
  static std::string text;
  return text;
}

KvfNode FirstParameter(KvfNode section, std::string_view key) {
  const KvfNode keyword = kvfKeywordByNameNum(section, key, 1);
  return keyword == nullptr ? nullptr : kvfParamByNum(keyword, 1);
}

/// A parameter's text as it is, or none with the report.
class RawText final {
 public:
  RawText(KvfNode section, std::string_view key, ReadStatus& status) {
    const KvfNode parameter = FirstParameter(section, key);
    isThere = parameter != nullptr && kvfGetText(parameter, buffer, value) == kKvfOk;
    if (isThere) {
      status.TextWasRead();
    } else {
      status.ReportMissing(section, key);
      status.NoteUnread(section, key, nullptr);
    }
  }
  RawText(const RawText&) = delete;
  RawText& operator=(const RawText&) = delete;

  bool IsThere() const { return isThere; }
  std::string_view Text() const { return value.text; }
  /// Gives a property a piece of the text.
  void GiveTo(CEL_Property& property, std::string_view piece) const {
    if (value.isLasting || piece.empty()) {
      property.StartWithText(piece);
    } else {
      property.SetText(piece);
    }
  }

 private:
  std::string buffer;
  KvfText value;
  bool isThere;
};

/// How the library reads a number of one type.
struct Reals {
  using Number = double;
  static constexpr auto kGet = kvfGetDouble;
  static constexpr auto kFits = kvfFitsDouble;
};
struct Integers {
  using Number = std::int32_t;
  static constexpr auto kGet = kvfGetInt;
  static constexpr auto kFits = kvfFitsInt;
};

/// Reads a number while numbers are read, and notes in the account what becomes of it otherwise.
template <class Type, class Take>
bool ReadNumber(KvfNode section, std::string_view key, const CEL_Property* property, ReadStatus& status,
                Take take) {
  if (status.ReadsNumbers()) {
    const KvfNode parameter = FirstParameter(section, key);
    typename Type::Number value{};
    if (parameter != nullptr && Type::kGet(parameter, value) == kKvfOk) {
      if (!Type::kFits(parameter)) {
        status.NoteCut(section, key, ShortestNumberText(static_cast<double>(value)));
      }
      take(value);
      return true;
    }
    status.ReportMissing(section, key);
  }
  status.NoteUnread(section, key, property);
  return false;
}

void ReadBoolean(CEL_Property& property, KvfNode section, std::string_view key, ReadStatus& status) {
  const RawText raw(section, key, status);
  const std::string_view text = raw.Text();
  property.StartWith(raw.IsThere() && text == kYes);
  if (raw.IsThere() && text != kYes && text != kNo) status.NoteReplaced(section, key, kNo);
}

void ReadExpression(CEL_Property& property, KvfNode section, std::string_view key, ReadStatus& status) {
  const RawText raw(section, key, status);
  const std::string_view stored = raw.Text();
  const std::string_view expression = StripExpressionQuotes(stored);
  raw.GiveTo(property, CleanText(expression));
  const auto start = static_cast<std::size_t>(expression.data() - stored.data());
  const auto holdsMore = [](std::string_view outside) {
    return outside.find_first_not_of("\" \n\r\t") != std::string_view::npos;
  };
  if (holdsMore(stored.substr(0, start)) || holdsMore(stored.substr(start + expression.size()))) {
    status.NoteCut(section, key, property.Text());
  }
}

std::string_view WriteFailureReason(int error) {
  switch (error) {
    case kKvfNotWritable:
      return "the format can not hold its text or name";
    case kKvfBadHandle:
      return "the file is not open";
    default:
      return "the key-file library refused it";
  }
}

}  // namespace

std::string_view CleanText(std::string_view text) {
  const std::size_t last = text.find_last_not_of(kBlanks);
  if (last == std::string_view::npos) return {};
  const std::size_t first = text.find_first_not_of(kBlanks);
  return text.substr(first, last - first + 1);
}

bool ReadText(std::string& text, KvfNode section, std::string_view key, ReadStatus& status) {
  const RawText raw(section, key, status);
  if (raw.IsThere()) text = CleanText(raw.Text());
  return raw.IsThere();
}

bool ReadInteger(std::int32_t& value, KvfNode section, std::string_view key, ReadStatus& status) {
  return ReadNumber<Integers>(section, key, nullptr, status,
                              [&value](std::int32_t number) { value = number; });
}

bool HasKeyword(KvfNode section, std::string_view key) {
  return kvfKeywordByNameNum(section, key, 1) != nullptr;
}

void ReadProperty(CEL_Property& property, KvfNode section, std::string_view key, ReadStatus& status) {
  switch (property.Type()) {
    case ValueType::Real:
      ReadNumber<Reals>(section, key, &property, status,
                        [&property](double number) { property.StartWith(number); });
      break;
    case ValueType::Integer:
      ReadNumber<Integers>(section, key, &property, status,
                           [&property](std::int32_t number) { property.StartWith(number); });
      break;
    case ValueType::Boolean:
      ReadBoolean(property, section, key, status);
      break;
    case ValueType::Expression:
      ReadExpression(property, section, key, status);
      break;
    default: {
      const RawText raw(section, key, status);
      raw.GiveTo(property, CleanText(raw.Text()));
      break;
    }
  }
}

void NoteWriteResult(int result, std::string_view key, CEL_Element& element, int& status) {
  if (result == kKvfOk) return;
  status = result;
  Errors().Report(element.symbol.Text(), element.GetUid(),
                  {"key-not-written", {key, WriteFailureReason(result)}});
}

void WriteText(std::string_view text, KvfHandle file, std::string_view key, CEL_Element& element,
               int& status) {
  int result = kvfAddKeyword(file, key);
  if (result == kKvfOk) result = kvfAddString(file, text);
  NoteWriteResult(result, key, element, status);
}

void WriteInteger(std::int32_t value, KvfHandle file, std::string_view key, CEL_Element& element,
                  int& status) {
  int result = kvfAddKeyword(file, key);
  if (result == kKvfOk) result = kvfAddInt(file, value);
  NoteWriteResult(result, key, element, status);
}

void WriteProperty(const CEL_Property& property, KvfHandle file, std::string_view key, CEL_Element& element,
                   int& status) {
  switch (property.Type()) {
    case ValueType::Real: {
      // The tiny addition makes the library write a whole number as a real.
      constexpr double kNudge = 1e-12;
      const double value = property.RealValue();
      const bool whole = std::trunc(value) == value;
      int result = kvfAddKeyword(file, key);
      if (result == kKvfOk)
        result = kvfAddDouble(file, property.ForceReal() && whole ? value + kNudge : value);
      NoteWriteResult(result, key, element, status);
      break;
    }
    case ValueType::Integer:
      WriteInteger(property.IntValue(), file, key, element, status);
      break;
    case ValueType::Boolean:
      WriteText(property.BoolValue() ? kYes : kNo, file, key, element, status);
      break;
    case ValueType::Expression:
      WriteText('"' + std::string(CleanText(property.Text())) + '"', file, key, element, status);
      break;
    default:
      WriteText(CleanText(property.Text()), file, key, element, status);
      break;
  }
}

const std::string& LastKeyError() {
  return LastKeyErrorText();
}

void NoteKeyError(std::string_view text) {
  LastKeyErrorText() = text;
}

void ClearLastKeyError() {
  LastKeyErrorText().clear();
}

}  // namespace tessal
