#include "support/case_file.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>

#include "platform/text_encoding.h"
#include "support/temporary_folder.h"

namespace tessal::test {

namespace {

constexpr std::string_view kTitle = "== ";
constexpr std::string_view kPrompt = "> ";
constexpr std::string_view kShellPrompt = "$ ";
constexpr std::string_view kNoLineEnd = "\\c";

std::string PathOf(std::string_view file) {
  return std::string(TESSAL_SOURCE_DIR) + "/tests/" + std::string(file);
}

std::vector<std::string> LinesOf(std::string_view text) {
  std::vector<std::string> lines;
  while (!text.empty()) {
    const std::size_t end = text.find('\n');
    lines.emplace_back(text.substr(0, end));
    text = end == std::string_view::npos ? std::string_view() : text.substr(end + 1);
  }
  return lines;
}

std::string Escaped(std::string_view line) {
  constexpr std::string_view kHex = "0123456789abcdef";
  if (line.empty()) return "\\";
  const bool isUtf8 = IsUtf8(line);
  std::string shown;
  for (const char character : line) {
    const auto byte = static_cast<unsigned char>(character);
    const bool isPlain = byte >= 0x80 ? isUtf8 : byte >= ' ' && byte < 0x7f;
    if (character == '\\') {
      shown += "\\\\";
    } else if (character == '\t') {
      shown += "\\t";
    } else if (character == '\r') {
      shown += "\\r";
    } else if (isPlain) {
      shown += character;
    } else {
      shown += std::string("\\x") + kHex[byte >> 4U] + kHex[byte & 15U];
    }
  }
  if (shown.back() == ' ') shown.replace(shown.size() - 1, 1, "\\s");
  if (shown.front() == '>' || shown.front() == '=' || shown.starts_with(kShellPrompt)) {
    shown.insert(0, 1, '\\');
  }
  return shown;
}

std::string Unescaped(std::string_view shown) {
  std::string line;
  for (std::size_t place = 0; place < shown.size(); ++place) {
    if (shown[place] != '\\' || ++place == shown.size()) {
      if (place < shown.size()) line += shown[place];
      continue;
    }
    if (shown[place] == 'x') {
      line += static_cast<char>(std::stoi(std::string(shown.substr(place + 1, 2)), nullptr, 16));
      place += 2;
    } else {
      constexpr std::string_view kNames = "trs";
      constexpr std::string_view kMeant = "\t\r ";
      const std::size_t name = kNames.find(shown[place]);
      line += name == std::string_view::npos ? shown[place] : kMeant[name];
    }
  }
  return line;
}

/// A file of cases as it is: what is written again keeps its remarks, titles, inputs and calls.
struct CaseFile {
  std::string remarks;
  std::vector<Case> cases;
};

CaseFile ReadCases(std::string_view file) {
  CaseFile read;
  int number = 0;
  for (const std::string& line : LinesOf(ReadFile(PathOf(file)))) {
    ++number;
    if (line.starts_with(kTitle)) {
      read.cases.push_back({line.substr(kTitle.size()), "", {}, number});
    } else if (read.cases.empty()) {
      read.remarks += line + "\n";
    } else if (line.starts_with(kPrompt) || line.starts_with(kShellPrompt)) {
      const std::string prompt = line.substr(0, kPrompt.size());
      read.cases.back().calls.push_back({prompt, line.substr(prompt.size()), "", number});
    } else if (!line.empty()) {
      Case& last = read.cases.back();
      std::string& text = last.calls.empty() ? last.input : last.calls.back().expected;
      if (line != kNoLineEnd) {
        text += Unescaped(line) + "\n";
      } else if (!text.empty()) {
        text.pop_back();
      }
    }
  }
  for (Case& each : read.cases) {
    if (each.input.ends_with('\n')) each.input.pop_back();
  }
  return read;
}

std::string TextOf(const CaseFile& file) {
  std::string text = file.remarks;
  for (const Case& each : file.cases) {
    text += (text.empty() || text.ends_with("\n\n") ? "" : "\n") + std::string(kTitle) + each.title + "\n";
    if (!each.input.empty()) text += ShownText(each.input + "\n");
    for (const CaseCall& call : each.calls) {
      text += call.prompt + call.words + "\n" + ShownText(call.expected);
    }
  }
  return text;
}

void Write(std::string_view file, std::string_view text) {
  std::ofstream(PathOf(file), std::ios::binary) << text;
}

/// Reports where a file and what it is to hold first differ, or writes the file.
void ExpectSame(std::string_view file, const std::string& given) {
  if (Blessing()) {
    Write(file, given);
    return;
  }
  const std::string path = PathOf(file);
  const std::vector<std::string> expectedLines = LinesOf(ReadFile(path));
  const std::vector<std::string> givenLines = LinesOf(given);
  for (std::size_t place = 0; place < std::max(expectedLines.size(), givenLines.size()); ++place) {
    const std::string want = place < expectedLines.size() ? expectedLines[place] : "(the end)";
    const std::string have = place < givenLines.size() ? givenLines[place] : "(the end)";
    if (want == have) continue;
    ADD_FAILURE_AT(path.c_str(), static_cast<int>(place + 1))
        << "expected: " << want << "\ngiven:    " << have;
    return;  // what follows is often only shifted
  }
}

}  // namespace

bool Blessing() {
  return std::getenv("TESSAL_BLESS") != nullptr && std::getenv("CI") == nullptr;
}

std::string ShownText(std::string_view text) {
  std::string shown;
  for (const std::string& line : LinesOf(text)) shown += Escaped(line) + "\n";
  if (!text.empty() && text.back() != '\n') shown += std::string(kNoLineEnd) + "\n";
  return shown;
}

void RunCases(std::string_view file, const std::function<Answer(const Case&)>& begin) {
  CaseFile cases = ReadCases(file);
  ASSERT_FALSE(cases.cases.empty()) << "no cases in " << file;
  for (Case& each : cases.cases) {
    const Answer answer = begin(each);
    for (CaseCall& call : each.calls) {
      std::string given = answer(call);
      if (!Blessing() && given != call.expected) {
        ADD_FAILURE_AT(PathOf(file).c_str(), call.line) << each.title << "\n"
                                                        << call.prompt << call.words << "\nexpected:\n"
                                                        << ShownText(call.expected) << "given:\n"
                                                        << ShownText(given);
      }
      call.expected = std::move(given);
    }
  }
  if (Blessing()) Write(file, TextOf(cases));
}

std::string AnswerEach(std::string_view lines, const std::function<std::string(const std::string&)>& answer) {
  std::string rows;
  for (const std::string& line : LinesOf(lines)) {
    std::string_view separator = " => ";
    rows += line;
    for (const std::string& part : LinesOf(answer(line))) {
      rows += separator;
      rows += part;
      separator = " | ";
    }
    rows += '\n';
  }
  return rows;
}

void ExpectPage(std::string_view file, std::string_view actual) {
  ExpectSame(file, std::string(actual));
}

void ExpectListing(std::string_view file, std::string_view actual) {
  ExpectSame(file, ShownText(actual));
}

}  // namespace tessal::test
