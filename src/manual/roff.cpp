#include "manual/roff.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>

#include "platform/ascii.h"

namespace tessal::manual {

namespace {

/// The code point that begins at a place, and the place after it.
std::uint32_t CodePointAt(std::string_view text, std::size_t& place) {
  const auto first = static_cast<unsigned char>(text[place++]);
  const int following = first >= 0xF0 ? 3 : first >= 0xE0 ? 2 : first >= 0xC0 ? 1 : 0;
  std::uint32_t point = following == 0 ? first : first & (0x3FU >> static_cast<unsigned>(following));
  for (int count = 0; count < following && place < text.size(); ++count) {
    point = (point << 6U) | (static_cast<unsigned char>(text[place++]) & 0x3FU);
  }
  return point;
}

std::string Named(std::uint32_t point) {
  char name[16];
  std::snprintf(name, sizeof name, "\\[u%04X]", static_cast<unsigned>(point));
  return name;
}

/// Whether a sign is a hyphen between two words, and not a minus sign or the start of an option.
bool IsHyphen(std::string_view text, std::size_t place) {
  return place > 0 && place + 1 < text.size() && IsWordCharacter(text[place - 1]) &&
         IsWordCharacter(text[place + 1]);
}

/// A line that begins with a point or a quote would be a request.
std::string Escaped(std::string_view text, bool isTyped) {
  std::string escaped;
  for (std::size_t place = 0; place < text.size();) {
    const char character = text[place];
    if (static_cast<unsigned char>(character) >= 0x80) {
      escaped += Named(CodePointAt(text, place));
      continue;
    }
    ++place;
    switch (character) {
      case '\\':
        escaped += "\\(rs";
        break;
      case '^':
        escaped += "\\(ha";
        break;
      case '~':
        escaped += "\\(ti";
        break;
      case '`':
        escaped += "\\(ga";
        break;
      case '\'':
        escaped += "\\(aq";
        break;
      case '-':
        escaped += isTyped || !IsHyphen(text, place - 1) ? "\\-" : "-";
        break;
      case '.':
        escaped += place == 1 ? "\\&." : ".";
        break;
      default:
        escaped += character;
    }
  }
  return escaped;
}

/// Words in lines of at most 80 bytes where they can be, each sentence on lines of its own: roff breaks no
/// line after a sentence of its own accord.
std::string Wrapped(const std::string& text) {
  constexpr std::size_t kWidth = 80;
  std::string lines;
  std::size_t used = 0;
  for (std::size_t place = 0; place < text.size();) {
    const std::size_t end = std::min(text.find(' ', place), text.size());
    const std::string_view word = std::string_view(text).substr(place, end - place);
    place = end + 1;
    if (word.empty()) continue;
    const bool isSentence = lines.ends_with('.') && word[0] >= 'A' && word[0] <= 'Z';
    // A word that begins with a sign of roff's must not begin a line.
    const bool mayBegin = word[0] != '.' && word[0] != '\'';
    if (used > 0) {
      const bool breaks = (isSentence || used + 1 + word.size() > kWidth) && mayBegin;
      lines += breaks ? '\n' : ' ';
      used = breaks ? 0 : used + 1;
    }
    lines += word;
    used += word.size();
  }
  return lines + '\n';
}

}  // namespace

std::string Prose(std::string_view words) {
  return Escaped(words, false);
}

std::string Typed(std::string_view text) {
  return "\\fB" + Escaped(text, true) + "\\fR";
}

std::string Placeholder(std::string_view name) {
  return "\\fI" + Escaped(name, true) + "\\fR";
}

ManualPage::ManualPage(const PageTitle& title, std::string_view version, std::string_view date) {
  text = "." + std::string("TH ") + UpperCase(title.name) + " " + std::to_string(title.section) + " \"" +
         std::string(date) + "\" \"tessal " + std::string(version) + "\" \"" + std::string(title.part) +
         "\"\n";
  // No justified lines and no hyphens of roff's own: what is typed is often long.
  text += ".nh\n.ad l\n.SH NAME\n" + Escaped(title.name, true) + " \\- " + Prose(title.summary) + "\n";
}

void ManualPage::Section(std::string_view title) {
  text += ".SH " + UpperCase(title) + "\n";
}

void ManualPage::Subsection(std::string_view title) {
  text += ".SS " + Prose(title) + "\n";
}

void ManualPage::Paragraph(const std::string& words) {
  // A paragraph right after a heading is one already.
  const std::size_t line = text.rfind('\n', text.size() - 2) + 1;
  const bool followsHeading = text.compare(line, 3, ".SH") == 0 || text.compare(line, 3, ".SS") == 0;
  text += (followsHeading ? "" : ".PP\n") + Wrapped(words);
}

void ManualPage::Item(const std::string& term, const std::string& words) {
  text += ".TP\n" + term + "\n" + Wrapped(words);
}

void ManualPage::Lines(std::string_view lines) {
  text += ".PP\n.RS 4\n.nf\n";
  while (!lines.empty()) {
    const std::size_t end = lines.find('\n');
    std::string_view line = lines.substr(0, end);
    while (line.ends_with(' ')) line.remove_suffix(1);
    text += Escaped(line, true) + "\n";
    lines.remove_prefix(end == std::string_view::npos ? lines.size() : end + 1);
  }
  text += ".fi\n.RE\n";
}

}  // namespace tessal::manual
