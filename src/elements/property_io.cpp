#include "elements/property_io.h"

#include <cmath>

#include "core/error_registry.h"
#include "elements/element.h"
#include "elements/property.h"
#include "expr/scanner.h"

namespace tessal {

namespace {

constexpr std::string_view kBlanks = " \n\r\t";

std::string& LastKeyErrorText() {
  static std::string text;
  return text;
}

void ReportMissing(KvfNode section, std::string_view key, int& status) {
  status = kStatusMissingKey;
  const Finding finding("missing-key", {key, kvfGetNameGlb(section)});
  Errors().ReportInFile("", kvfGetLine(section), finding);
  LastKeyErrorText() = finding.text;
}

KvfNode FirstParameter(KvfNode section, std::string_view key) {
  const KvfNode keyword = kvfKeywordByNameNum(section, key, 1);
  return keyword == nullptr ? nullptr : kvfParamByNum(keyword, 1);
}

/// The parameter's text as it is, with the report when there is none.
bool ReadRawText(std::string& text, KvfNode section, std::string_view key, int& status) {
  const KvfNode parameter = FirstParameter(section, key);
  if (parameter == nullptr || kvfGetString(parameter, text) != kKvfOk) {
    ReportMissing(section, key, status);
    return false;
  }
  status = 0;
  return true;
}

void ReadReal(CEL_Property& property, KvfNode section, std::string_view key, int& status) {
  if (status != 0) return;
  const KvfNode parameter = FirstParameter(section, key);
  double value = 0.0;
  if (parameter == nullptr || kvfGetDouble(parameter, value) != kKvfOk) {
    ReportMissing(section, key, status);
    return;
  }
  property.SetReal(value);
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

bool ReadText(std::string& text, KvfNode section, std::string_view key, int& status) {
  std::string raw;
  if (!ReadRawText(raw, section, key, status)) return false;
  text = CleanText(raw);
  return true;
}

bool ReadInteger(std::int32_t& value, KvfNode section, std::string_view key, int& status) {
  if (status != 0) return false;
  const KvfNode parameter = FirstParameter(section, key);
  if (parameter != nullptr && kvfGetInt(parameter, value) == kKvfOk) return true;
  ReportMissing(section, key, status);
  return false;
}

bool HasKeyword(KvfNode section, std::string_view key) {
  return kvfKeywordByNameNum(section, key, 1) != nullptr;
}

void ReadProperty(CEL_Property& property, KvfNode section, std::string_view key, int& status) {
  std::string text;
  switch (property.Type()) {
    case ValueType::Real:
      ReadReal(property, section, key, status);
      break;
    case ValueType::Integer: {
      std::int32_t value = 0;
      if (ReadInteger(value, section, key, status)) property.SetInt(value);
      break;
    }
    case ValueType::Boolean:
      property.SetBool(ReadRawText(text, section, key, status) && text == kYes);
      break;
    case ValueType::Expression:
      ReadRawText(text, section, key, status);
      property.SetText(CleanText(StripExpressionQuotes(text)));
      break;
    default:
      ReadRawText(text, section, key, status);
      property.SetText(CleanText(text));
      break;
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

void ClearLastKeyError() {
  LastKeyErrorText().clear();
}

}  // namespace tessal
