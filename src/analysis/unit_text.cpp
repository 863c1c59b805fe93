#include "analysis/unit_text.h"

#include <charconv>
#include <cmath>
#include <utility>
#include <vector>

#include "analysis/unit_database.h"
#include "analysis/unit_words.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

constexpr std::size_t kLongestText = 200;
constexpr double kLargestPower = 20;

enum class TokenKind { Word, Number, Times, Divide, Open, Close };

struct UnitToken {
  TokenKind kind;
  std::string text{};  ///< of a word, without the power
  double value = 1;    ///< of a number
  double power = 1;    ///< that follows a word, a number or a bracket
  bool hasPower = false;
};

std::optional<double> NumberIn(std::string_view text) {
  double value = 0;
  const auto read = std::from_chars(text.data(), text.data() + text.size(), value);
  if (read.ec != std::errc() || read.ptr != text.data() + text.size()) return std::nullopt;
  return value;
}

/// The text in ASCII; none where it has other signs.
std::optional<std::string> InAscii(std::string_view text) {
  std::string ascii;
  while (!text.empty()) {
    if (static_cast<unsigned char>(text.front()) < 0x80) {
      ascii += text.front();
      text.remove_prefix(1);
      continue;
    }
    const SignSpelling* sign = SignAt(text);
    if (sign == nullptr) return std::nullopt;
    ascii += sign->ascii;
    text.remove_prefix(sign->bytes.size());
  }
  return ascii;
}

/// Makes tokens of a text.
class UnitScanner final {
 public:
  explicit UnitScanner(std::string_view scanned) : text(scanned) {}

  /// None where a sign has no meaning in a unit.
  std::optional<std::vector<UnitToken>> Tokens() {
    while (place < text.size()) {
      if (!TakeOne()) return std::nullopt;
    }
    return std::move(tokens);
  }

 private:
  char At(std::size_t index) const { return index < text.size() ? text[index] : '\0'; }
  bool IsDigitAt(std::size_t index) const { return IsAsciiDigit(At(index)); }

  bool TakeOne() {
    const char next = At(place);
    if (next == ' ' || next == '\t') return ++place, true;
    if (IsAsciiLetter(next) || next == '%') return TakeWord();
    if (IsAsciiDigit(next)) return TakeNumber();
    if (next == '*' && At(place + 1) == '*') return place += 2, TakePower();
    if (next == '^') return ++place, TakePower();
    ++place;
    switch (next) {
      case '*':
      case '.':
      case '-':  // "N-m"; a power's sign is taken with the word before it
        tokens.push_back({TokenKind::Times});
        return true;
      case '/':
        tokens.push_back({TokenKind::Divide});
        return true;
      case '(':
      case '[':
        tokens.push_back({TokenKind::Open});
        return true;
      case ')':
      case ']':
        tokens.push_back({TokenKind::Close});
        return !IsSignedDigit() || TakePower();
      default:
        return false;
    }
  }

  bool TakeWord() {
    std::size_t end = place + 1;
    while (IsAsciiLetter(At(end)) || (IsDigitAt(end) && At(place) != '%')) ++end;
    // A hyphen belongs to a substance, "NO3-N", "mgChl-a", and is a product otherwise.
    if (At(end) == '-' && IsAsciiLetter(At(end + 1))) {
      std::size_t last = end + 1;
      while (IsAsciiLetter(At(last)) || IsDigitAt(last)) ++last;
      for (std::size_t start = place; start < end; ++start) {
        if (!SubstanceOf(text.substr(start, last - start))) continue;
        end = last;
        break;
      }
    }
    tokens.push_back({.kind = TokenKind::Word, .text = std::string(text.substr(place, end - place))});
    place = end;
    // The power may follow at once: "m-2".
    return !IsSignedDigit() || TakePower();
  }

  bool IsSignedDigit() const { return (At(place) == '-' || At(place) == '+') && IsDigitAt(place + 1); }

  bool TakeNumber() {
    double value = 0;
    const auto read = std::from_chars(text.data() + place, text.data() + text.size(), value);
    if (read.ec != std::errc() || !(value > 0)) return false;
    place = static_cast<std::size_t>(read.ptr - text.data());
    tokens.push_back({.kind = TokenKind::Number, .value = value});
    return true;
  }

  std::string_view Digits(std::size_t& at) const {
    const std::size_t start = at;
    if (At(at) == '-' || At(at) == '+') ++at;
    while (IsDigitAt(at) || (At(at) == '.' && IsDigitAt(at + 1))) ++at;
    std::string_view digits = text.substr(start, at - start);
    if (digits.starts_with('+')) digits.remove_prefix(1);
    return digits;
  }

  /// "2", "-1", "0.5", "1/2", "(1/2)"; what it belongs to is the last token.
  bool TakePower() {
    if (tokens.empty() || tokens.back().hasPower || tokens.back().kind == TokenKind::Times ||
        tokens.back().kind == TokenKind::Divide || tokens.back().kind == TokenKind::Open) {
      return false;
    }
    const bool inBrackets = At(place) == '(';
    std::size_t at = place + (inBrackets ? 1 : 0);
    std::optional<double> power = NumberIn(Digits(at));
    if (!power) return false;
    if (At(at) == '/' && IsDigitAt(at + 1)) {
      ++at;
      const std::optional<double> divisor = NumberIn(Digits(at));
      if (!divisor || *divisor <= 0 || *divisor > kLargestPower) return false;
      *power /= *divisor;
    }
    if (inBrackets && At(at++) != ')') return false;
    place = at;
    tokens.back().power = *power;
    tokens.back().hasPower = true;
    return std::abs(*power) <= kLargestPower;
  }

  std::string_view text;
  std::size_t place = 0;
  std::vector<UnitToken> tokens;
};

/// A word is read by the table first, then by UDUNITS.
std::optional<Unit> UnitOfWord(std::string_view word) {
  if (word == "%") return UnitInDatabase("percent");
  const UnitWord* row = UnitWordOf(word);
  if (row == nullptr) return UnitInDatabase(word);
  if (row->meaning == WordMeaning::NoUnit) return std::nullopt;
  std::optional<Unit> unit = UnitInDatabase(row->unit);
  if (unit) unit->isFactorOpen = row->meaning == WordMeaning::OpenFactor;
  return unit;
}

/// Whether a unit can have a substance: a mass or a number of moles.
bool IsAmount(const Unit& unit) {
  Unit other = unit;
  const double mass = std::exchange(other.Power(BaseUnit::Kilogram), 0);
  const double moles = std::exchange(other.Power(BaseUnit::Mole), 0);
  return IsDimensionless(other) && IsNear(mass + moles, 1) && IsNear(mass * moles, 0);
}

/// Takes tokens into a product.
class UnitProduct final {
 public:
  explicit UnitProduct(std::vector<UnitToken> taken) : tokens(std::move(taken)) {}

  std::optional<Unit> Read() {
    for (place = 0; place < tokens.size(); ++place) {
      if (!Take(tokens[place])) return std::nullopt;
    }
    if (!open.empty() || !hasFactor || isAfterSign) return std::nullopt;
    CloseAmount();
    // No quantity has such a factor, and a number holds what is written of it.
    constexpr double kLargestLogFactor = 150;
    if (std::abs(product.logFactor) > kLargestLogFactor) return std::nullopt;
    return product;
  }

 private:
  struct OpenBracket {
    Unit before;
    double sign;
  };
  /// The last amount, which may yet get its substance.
  struct Amount {
    double sign = 0;  ///< of its place; 0 where there is none
    double power = 1;
    Unit unit;
  };

  bool Take(const UnitToken& token) {
    switch (token.kind) {
      case TokenKind::Times:
        if (isAfterSign || !hasFactor) return false;
        isAfterSign = true;
        sign = 1;
        return true;
      case TokenKind::Divide:
        return TakeDivision();
      case TokenKind::Open:
        return OpenOne();
      case TokenKind::Close:
        return CloseOne(token.power);
      case TokenKind::Number:
        return TakeNumber(token);
      case TokenKind::Word:
        return TakeWord(token);
    }
    return false;
  }

  bool TakeDivision() {
    if (isAfterSign) return false;
    isAfterSign = true;
    hasFactor = true;
    sign = -1;
    return true;
  }

  bool OpenOne() {
    constexpr std::size_t kDeepest = 8;
    if (open.size() == kDeepest) return false;
    CloseAmount();
    open.push_back({std::exchange(product, Unit{}), std::exchange(sign, 1)});
    hasFactor = false;
    isAfterSign = false;
    return true;
  }

  bool CloseOne(double power) {
    if (open.empty() || !hasFactor || isAfterSign) return false;
    CloseAmount();
    OpenBracket bracket = std::move(open.back());
    open.pop_back();
    MultiplyBy(bracket.before, product, bracket.sign * power);
    product = std::move(bracket.before);
    return EndFactor();
  }

  bool TakeNumber(const UnitToken& token) {
    CloseAmount();
    Unit number;
    number.logFactor = std::log(token.value);
    MultiplyBy(product, number, sign * token.power);
    // "per 100 ml": the unit is below the line too.
    const bool measures =
        place + 1 < tokens.size() && tokens[place + 1].kind == TokenKind::Word && !IsPer(tokens[place + 1]);
    hasFactor = true;
    isAfterSign = false;
    if (!measures) sign = 1;
    return true;
  }

  static bool IsPer(const UnitToken& token) { return EqualIgnoringCase(token.text, "per"); }

  bool TakeWord(const UnitToken& token) {
    UnitToken word = WithPhrase(token);
    if (IsPer(word) && !word.hasPower) return TakeDivision();
    if (amount.sign != 0 && !IsAfterDivision() && TakeSubstance(word)) return true;
    SplitPower(word);
    if (const std::optional<Unit> unit = UnitOfWord(word.text)) return TakeUnit(*unit, word.power), true;
    return TakeGluedSubstance(word);
  }

  bool IsAfterDivision() const { return isAfterSign && sign < 0; }

  /// The token, or the word for the phrase that begins there, which is then taken.
  UnitToken WithPhrase(const UnitToken& token) {
    std::string phrase = token.text;
    UnitToken result = token;
    std::size_t last = place;
    for (std::size_t next = place + 1; next < tokens.size() && next < place + kLongestPhrase; ++next) {
      if (tokens[next].kind != TokenKind::Word || tokens[next - 1].hasPower) break;
      phrase += ' ' + tokens[next].text;
      if (const PhraseSpelling* row = PhraseOf(phrase)) {
        result = tokens[next];
        result.text = row->word;
        last = next;
      }
    }
    place = last;
    return result;
  }

  /// Digits at the end of a word are its power: "m2".
  static void SplitPower(UnitToken& word) {
    if (word.hasPower) return;
    std::size_t end = word.text.size();
    while (end > 1 && IsAsciiDigit(word.text[end - 1])) --end;
    if (end == word.text.size()) return;
    const std::optional<double> power = NumberIn(std::string_view(word.text).substr(end));
    if (!power || *power > kLargestPower) return;
    word.power = *power;
    word.text.resize(end);
  }

  void TakeUnit(const Unit& unit, double power) {
    CloseAmount();
    MultiplyBy(product, unit, sign * power);
    if (IsAmount(unit)) amount = {sign, power, unit};
    EndFactor();
  }

  bool EndFactor() {
    hasFactor = true;
    isAfterSign = false;
    sign = 1;
    return true;
  }

  bool TakeSubstance(const UnitToken& word) {
    std::optional<std::string_view> substance;
    double power = word.power;
    // "mmol2 N2" is the square of "mmol N".
    UnitToken split = word;
    SplitPower(split);
    if (amount.power != 1 && IsNear(split.power, amount.power)) {
      substance = SubstanceOf(split.text);
      if (substance) power = 1;
    }
    if (!substance) substance = SubstanceOf(word.text);
    if (!substance) return false;
    Unit named;
    named.substances.push_back({*substance, 1});
    MultiplyBy(product, named, amount.sign * amount.power * power);
    // "mg Chl-1" is "(mg Chl)-1".
    if (power != 1) MultiplyBy(product, amount.unit, amount.sign * amount.power * (power - 1));
    amount = {};
    isAfterSign = false;
    return true;
  }

  /// "gC", "mgChl".
  bool TakeGluedSubstance(const UnitToken& word) {
    const std::string_view text = word.text;
    for (std::size_t end = 1; end < text.size(); ++end) {
      if (!SubstanceOf(text.substr(end))) continue;
      const std::optional<Unit> unit = UnitOfWord(text.substr(0, end));
      if (!unit || !IsAmount(*unit)) continue;
      TakeUnit(*unit, 1);
      UnitToken substance{.kind = TokenKind::Word, .text = std::string(text.substr(end))};
      substance.power = word.power;
      return TakeSubstance(substance);
    }
    return false;
  }

  /// An amount that no substance has followed.
  void CloseAmount() {
    if (amount.sign != 0) product.hasUnnamedAmount = true;
    amount = {};
  }

  std::vector<UnitToken> tokens;
  std::size_t place = 0;
  Unit product;
  std::vector<OpenBracket> open;
  Amount amount;
  double sign = 1;
  bool hasFactor = false;    ///< in the innermost bracket
  bool isAfterSign = false;  ///< of a product or a division
};

std::string_view Trimmed(std::string_view text) {
  const std::size_t first = text.find_first_not_of(" \t");
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

}  // namespace

std::optional<Unit> ReadUnitText(std::string_view text) {
  if (text.size() > kLongestText) return std::nullopt;
  const std::optional<std::string> ascii = InAscii(text);
  if (!ascii) return std::nullopt;
  const std::string_view trimmed = Trimmed(*ascii);
  if (SaysPlainNumber(trimmed)) return Unit{};
  std::optional<std::vector<UnitToken>> tokens = UnitScanner(trimmed).Tokens();
  if (!tokens) return std::nullopt;
  return UnitProduct(std::move(*tokens)).Read();
}

const Unit* UnitReader::Read(std::string_view text) {
  auto place = units.find(text);
  if (place == units.end()) place = units.emplace(text, ReadUnitText(text)).first;
  return place->second ? &*place->second : nullptr;
}

}  // namespace tessal
