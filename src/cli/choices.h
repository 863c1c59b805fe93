// The words that options take, and what each means: a new format is a row here.
#pragma once

#include <array>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "cli/commands.h"

namespace tessal::cli {

template <class Value>
struct Choice {
  std::string_view word;
  Value value;
};

template <class Value>
using Choices = std::span<const Choice<Value>>;

inline constexpr std::array<Choice<Format>, 7> kCheckFormats = {{
    {"text", Format::Text},
    {"json", Format::Json},
    {"sarif", Format::Sarif},
    {"github", Format::Github},
    {"gitlab", Format::Gitlab},
    {"junit", Format::Junit},
    {"gcc", Format::Gcc},
}};
/// What a table is printed in.
inline constexpr Choices<Format> kTableFormats = Choices<Format>(kCheckFormats).first<2>();

/// What a search looks in.
inline constexpr std::array<Choice<FindIn>, 3> kFindIn = {{
    {"expressions", FindIn::Expressions},
    {"texts", FindIn::Texts},
    {"all", FindIn::All},
}};

/// Severities, by their words in small letters.
inline constexpr std::array<Choice<int>, 4> kLevels = {{
    {"notice", 1},
    {"warning", 2},
    {"critical", 3},
    {"fatal", 4},
}};

/// What descriptions are printed in.
inline constexpr std::array<Choice<Format>, 4> kDescriptionFormats = {{
    {"text", Format::Text},
    {"json", Format::Json},
    {"markdown", Format::Markdown},
    {"html", Format::Html},
}};

/// What the process matrix is printed in.
inline constexpr std::array<Choice<Format>, 4> kMatrixFormats = {{
    {"text", Format::Text},
    {"csv", Format::Csv},
    {"json", Format::Json},
    {"latex", Format::Latex},
}};

/// What the tables of a model are printed in.
inline constexpr std::array<Choice<Format>, 3> kModelTableFormats = {{
    {"md", Format::Markdown},
    {"csv", Format::Csv},
    {"json", Format::Json},
}};

/// What a graph is printed in, and where it goes from its focus.
inline constexpr std::array<Choice<GraphFormat>, 5> kGraphFormats = {{
    {"dot", GraphFormat::Dot},
    {"mermaid", GraphFormat::Mermaid},
    {"graphml", GraphFormat::Graphml},
    {"json", GraphFormat::Json},
    {"svg", GraphFormat::Svg},
}};
inline constexpr std::array<Choice<GraphDirection>, 3> kGraphDirections = {{
    {"up", GraphDirection::Up},
    {"down", GraphDirection::Down},
    {"both", GraphDirection::Both},
}};

/// What a word means; nothing for a word that is no choice.
template <class Value>
std::optional<Value> ValueOf(Choices<Value> choices, std::string_view word) {
  for (const Choice<Value>& choice : choices) {
    if (choice.word == word) return choice.value;
  }
  return std::nullopt;
}

/// All words, for help and messages: "text, json, sarif".
template <class Value>
std::string WordsOf(Choices<Value> choices) {
  std::string words;
  for (const Choice<Value>& choice : choices) {
    if (!words.empty()) words += ", ";
    words += choice.word;
  }
  return words;
}

}  // namespace tessal::cli
