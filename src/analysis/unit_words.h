// How modellers spell units, as tables: what UDUNITS does not know, what it takes for something else, and
// what an amount can be one of.
#pragma once

#include <optional>
#include <string_view>

namespace tessal {

/// A byte sequence of UTF-8 or Windows-1252 at the start of a text, and what it means in ASCII.
struct SignSpelling {
  std::string_view bytes;
  std::string_view ascii;
};
/// The row whose bytes a text starts with, or none.
const SignSpelling* SignAt(std::string_view text);

/// Whether a whole text says "a plain number": "-", "()".
bool SaysPlainNumber(std::string_view text);

/// Several words that mean one: "degrees C" is "degC", "dry weight" is "DW".
struct PhraseSpelling {
  std::string_view phrase;  ///< in small letters, one blank between words
  std::string_view word;
};
/// The row of a phrase in any case, or none.
const PhraseSpelling* PhraseOf(std::string_view phrase);
/// The words of the longest phrase.
inline constexpr int kLongestPhrase = 4;

enum class WordMeaning {
  Unit,        ///< that of the row
  OpenFactor,  ///< the same, whose factor follows from a convention
  NoUnit       ///< none, though UDUNITS would find one
};

struct UnitWord {
  std::string_view word;
  std::string_view unit;  ///< for UDUNITS
  WordMeaning meaning;
  std::string_view reason;  ///< why UDUNITS is not asked
};
/// The row of a word: spelt exactly so, or in any case from three letters on. None for any other word.
const UnitWord* UnitWordOf(std::string_view word);

/// The name of a substance, the same for all its spellings; none for any other word.
std::optional<std::string_view> SubstanceOf(std::string_view word);

}  // namespace tessal
