#include "platform/kvf_writer.h"

#include <utility>

namespace tessal {

namespace {

constexpr std::size_t kBlanksPerLevel = 3;
constexpr std::string_view kLineEnd = "\r\n";

}  // namespace

void KvfWriter::OpenSection(std::string_view name) {
  EndKeyword();
  BeginLine();
  text += '[';
  text += name;
  text += ']';
  text += kLineEnd;
  openSections.emplace_back(name);
}

void KvfWriter::CloseSection() {
  EndKeyword();
  const std::string name = std::move(openSections.back());
  openSections.pop_back();
  BeginLine();
  text += "EndSect  // ";
  text += name;
  text += kLineEnd;
  text += kLineEnd;
}

void KvfWriter::AddKeyword(std::string_view name) {
  EndKeyword();
  BeginLine();
  text += name;
  text += " = ";
  keyword = Keyword::Fresh;
}

void KvfWriter::AddNumber(std::string_view number) {
  BeginValue();
  text += number;
}

void KvfWriter::AddText(std::string_view value, char quote) {
  BeginValue();
  text += quote;
  AppendText(value);
  text += quote;
}

std::string KvfWriter::TakeText() {
  while (HasOpenSection()) CloseSection();
  return std::move(text);
}

void KvfWriter::BeginLine() {
  text.append(kBlanksPerLevel * openSections.size(), ' ');
}

void KvfWriter::EndKeyword() {
  if (HasOpenKeyword()) text += kLineEnd;
  keyword = Keyword::None;
}

void KvfWriter::BeginValue() {
  if (keyword == Keyword::HasValues) text += ", ";
  keyword = Keyword::HasValues;
}

void KvfWriter::AppendText(std::string_view value) {
  if (value.find('\n') == std::string_view::npos && value.find('\r') == std::string_view::npos) {
    text += value;
    return;
  }
  while (true) {
    const std::size_t next = value.find_first_of(kLineEnd);
    text += value.substr(0, next);
    if (next == std::string_view::npos) return;
    if (value[next] == '\n') text += kLineEnd;
    value.remove_prefix(next + 1);
  }
}

}  // namespace tessal
