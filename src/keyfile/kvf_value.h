// One value of a key-file keyword: a boolean, a number or a text.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace tessal {

/// A text is a view, and lies in the memory of the tree that the value is in.
class KvfValue final {
 public:
  enum Tag : std::uint8_t { kBoolean = 1, kInteger = 2, kReal = 3, kQuoted = 4, kPath = 5 };

  static KvfValue Boolean(bool value) {
    KvfValue made(kBoolean);
    made.boolean = value;
    return made;
  }
  static KvfValue Integer(std::int32_t value) {
    KvfValue made(kInteger);
    made.integer = value;
    return made;
  }
  static KvfValue Real(double value) {
    KvfValue made(kReal);
    made.real = value;
    return made;
  }
  static KvfValue Quoted(std::string_view value) { return Text(kQuoted, value); }
  static KvfValue Path(std::string_view value) { return Text(kPath, value); }

  Tag Type() const { return tag; }
  bool IsText() const { return tag == kQuoted || tag == kPath; }

  /// Each raises an exception with the text "Incompatible type!" for a value of another type.
  bool AsBoolean() const;
  std::int32_t AsInteger() const;
  double AsReal() const;
  std::string_view AsString() const;
  /// The same value with another text; the old one may go.
  KvfValue WithText(std::string_view value) const { return Text(tag, value); }

  /// Appends the value as the file holds it: reals with 16 significant digits, texts between their quotes.
  void AppendTo(std::string& written) const;

  /// Equal type and equal content; the integer 1 differs from the real 1.0.
  friend bool operator==(const KvfValue& left, const KvfValue& right);

 private:
  explicit KvfValue(Tag type) : text(nullptr), tag(type) {}
  static KvfValue Text(Tag type, std::string_view value) {
    KvfValue made(type);
    made.text = value.data();
    made.size = static_cast<std::uint32_t>(value.size());
    return made;
  }

  union {
    const char* text;
    double real;
    std::int32_t integer;
    bool boolean;
  };
  std::uint32_t size = 0;  ///< of the text
  Tag tag;
};

static_assert(sizeof(KvfValue) == 16);

}  // namespace tessal
