// One value of a key-file keyword: a boolean, a number or a text.
#pragma once

#include <cstdint>
#include <iosfwd>
#include <string>
#include <utility>
#include <variant>

namespace tessal {

class KvfValue final {
 public:
  enum Tag : std::int32_t { kBoolean = 1, kInteger = 2, kReal = 3, kQuoted = 4, kPath = 5 };

  static KvfValue Boolean(bool value) { return {kBoolean, value}; }
  static KvfValue Integer(std::int32_t value) { return {kInteger, value}; }
  static KvfValue Real(double value) { return {kReal, value}; }
  static KvfValue Quoted(std::string text) { return {kQuoted, std::move(text)}; }
  static KvfValue Path(std::string text) { return {kPath, std::move(text)}; }

  Tag Type() const { return tag; }

  /// Each raises an exception with the text "Incompatible type!" for a value of another type.
  bool AsBoolean() const;
  std::int32_t AsInteger() const;
  double AsReal() const;
  const std::string& AsString() const;

  /// Writes the value as the file holds it: reals with 16 significant digits, texts between their quotes.
  void Write(std::ostream& stream) const;

  /// Equal type and equal content; the integer 1 differs from the real 1.0.
  friend bool operator==(const KvfValue& left, const KvfValue& right) = default;

 private:
  using Content = std::variant<bool, std::int32_t, double, std::string>;

  KvfValue(Tag type, Content value) : tag(type), content(std::move(value)) {}

  Tag tag;
  Content content;
};

}  // namespace tessal
