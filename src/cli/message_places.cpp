#include "cli/message_places.h"

#include <algorithm>
#include <array>
#include <optional>
#include <string>
#include <unordered_map>

#include "cli/element_index.h"
#include "cli/file_lines.h"
#include "cli/output.h"
#include "cli/template_messages.h"
#include "core/template_core.h"
#include "expr/parser.h"
#include "expr/plain_language.h"
#include "expr/semantic_checks.h"
#include "expr/token_spans.h"
#include "keyfile/keywords.h"

namespace tessal::cli {

namespace {

constexpr std::string_view kBlanks = " \t\r\n";

/// A text without the blanks around it.
std::string_view Trimmed(std::string_view text) {
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return text.substr(0, 0);
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::string_view FirstLine(std::string_view text) {
  return text.substr(0, text.find('\n'));
}

std::string_view WithoutComment(std::string_view line) {
  return line.substr(0, line.find("//"));
}

/// The text of a value that begins a text: what is between its quotes, or all up to the end of the line.
std::string_view ValueAt(std::string_view text) {
  const char quote = text.empty() ? '\0' : text.front();
  if (quote != '\'' && quote != '|') return Trimmed(WithoutComment(FirstLine(text)));
  const std::size_t end = text.find(quote, 1);
  return end == std::string_view::npos ? Trimmed(FirstLine(text)) : text.substr(1, end - 1);
}

/// The value of a keyword in the section whose head begins the text; empty where the section itself, up to
/// the first section in it, does not have it.
std::string_view ValueOf(std::string_view section, std::string_view keyword) {
  std::size_t place = section.find('\n');
  while (place != std::string_view::npos) {
    place = section.find_first_not_of(kBlanks, place);
    if (place == std::string_view::npos || section[place] == '[') return {};
    const std::string_view line = FirstLine(section.substr(place));
    if (line.starts_with("EndSect")) return {};
    const std::size_t sign = line.find('=');
    const std::string_view word = Trimmed(line.substr(0, sign));
    const bool isComment = word.starts_with("//");
    if (sign == std::string_view::npos || isComment) {
      place = section.find('\n', place);
      continue;
    }
    const std::size_t start = std::min(section.find_first_not_of(" \t", place + sign + 1), section.size());
    const std::string_view value = ValueAt(section.substr(start));
    if (word == keyword) return value;
    // A text may go on over several lines.
    place = section.find('\n', static_cast<std::size_t>(value.data() - section.data()) + value.size());
  }
  return {};
}

/// The faults and the names in the expressions of one element, as parts of the file's text.
class ElementParts final {
 public:
  explicit ElementParts(const CEL_Element& described) : element(described) {}

  /// Where an expression stops parsing with that message, which names the element or one of its expressions.
  std::string_view Syntax(std::string_view caption, std::string_view message) {
    FindFaultsOnce();
    const std::string_view part = Found(syntax, CaptionedMessage(caption, message));
    return part.data() == nullptr ? Found(syntax, message) : part;
  }
  /// What in an expression that message of a call or a property is about.
  std::string_view Call(std::string_view message) {
    FindFaultsOnce();
    return Found(calls, message);
  }
  /// The uses of a name.
  const std::vector<std::string_view>& Uses(std::string_view name) {
    static const std::vector<std::string_view> kNone;
    FindNamesOnce();
    const auto hit = names.find(name);
    return hit == names.end() ? kNone : hit->second;
  }

 private:
  using PartOfMessage = std::unordered_map<std::string, std::string_view>;

  static std::string CaptionedMessage(std::string_view caption, std::string_view message) {
    return std::string(caption) + '\0' + std::string(message);
  }

  static std::string_view Found(const PartOfMessage& parts, std::string_view message) {
    const auto hit = parts.find(std::string(message));
    return hit == parts.end() ? std::string_view() : hit->second;
  }

  void FindFaultsOnce() {
    if (hasFaults) return;
    hasFaults = true;
    element.ForEachExpression([this](const PropertyRow& row, const CEL_Property& expression) {
      const std::string_view text = StripExpressionQuotes(expression.Text());
      const ParsedExpression& parsed = expression.Parsed();
      if (parsed.Failure() != nullptr)
        return FindSyntaxFault(row.caption, text, parsed.Failure()->finding.text);
      for (const CallFinding& fault : FindCallFaults(*parsed.Tree())) {
        calls.try_emplace(fault.finding.text, PartOfCall(text, fault.name));
      }
    });
  }

  void FindSyntaxFault(std::string_view caption, std::string_view text, const std::string& failure) {
    const std::vector<ExpressionFault> faults = FindLanguageFaults(text);
    const bool isThere = !faults.empty() && faults.front().isSyntax;
    // One that follows from a comment that an earlier expression left open has no place of its own.
    const std::string_view part =
        isThere ? text.substr(faults.front().at.start, faults.front().at.length) : text;
    const std::string_view message = WithoutLineFeed(failure);
    syntax.try_emplace(CaptionedMessage(caption, message), part);
    syntax.try_emplace(std::string(message), part);
  }

  /// The name of a call is a part of the text, but for that of a call by `$`.
  static std::string_view PartOfCall(std::string_view text, std::string_view name) {
    if (name.data() >= text.data() && name.data() + name.size() <= text.data() + text.size()) return name;
    for (const TokenSpan& token : TokenSpans(text)) {
      if (token.code == TokenCode::RvalId) return TextOf(text, token);
    }
    return text;
  }

  void FindNamesOnce() {
    if (hasNames) return;
    hasNames = true;
    element.ForEachExpression([this](const PropertyRow&, const CEL_Property& expression) {
      const std::string_view text = StripExpressionQuotes(expression.Text());
      for (const TokenSpan& token : TokenSpans(text)) {
        if (token.code == TokenCode::Identifier) names[TextOf(text, token)].push_back(TextOf(text, token));
      }
    });
  }

  const CEL_Element& element;
  bool hasFaults = false;
  bool hasNames = false;
  PartOfMessage syntax;
  PartOfMessage calls;
  std::unordered_map<std::string_view, std::vector<std::string_view>> names;
};

class MessagePlaces final {
 public:
  explicit MessagePlaces(const TemplateCore& placed) : lines(placed.SourceText()), elements(placed) {}

  void Place(TemplateMessage& message) {
    const CEL_Element* element = IsElement(message.uid) ? elements.Find(message.uid) : nullptr;
    if (element != nullptr && PlaceAt(message.place, PartOf(message, *element))) return;
    message.place = PlaceOfLine(message.place.line);
  }

  void Place(UndefinedName::User& user, std::string_view name) {
    const CEL_Element* element = elements.Find(user.uid);
    if (element != nullptr) {
      for (const std::string_view use : PartsOf(*element).Uses(name)) {
        FilePlace place;
        if (PlaceAt(place, use)) user.uses.push_back(place);
      }
    }
    if (!user.uses.empty()) {
      user.place = user.uses.front();
    } else {
      user.place = PlaceOfLine(user.place.line);
    }
  }

  FilePlace PlaceOfLine(int line) {
    const FilePlace place = lines.PlaceOfLine(line);
    return place.line > 0 ? place : FilePlace{line};
  }

 private:
  /// The part of the file's text that a message is about; empty for the element as a whole.
  std::string_view PartOf(const TemplateMessage& message, const CEL_Element& element) {
    const MessageRow* row = FindMessage(message.code);
    if (row == nullptr) return {};
    switch (row->about.topic) {
      case MessageTopic::Syntax:
        return PartsOf(element).Syntax(message.symbol, message.text);
      case MessageTopic::Call:
        return PartsOf(element).Call(message.text);
      case MessageTopic::Name: {
        const auto& uses = PartsOf(element).Uses(message.name);
        return uses.empty() ? std::string_view() : uses.front();
      }
      case MessageTopic::Text:
        return IllegalCharacterOf(element);
      case MessageTopic::Field:
        return ValueOf(lines.From(element.SourceLine()), row->about.keyword);
      default:
        return {};
    }
  }

  /// The first "!" of the descriptive texts.
  static std::string_view IllegalCharacterOf(const CEL_Element& element) {
    for (const CEL_Property* property : {&element.description, &element.onlineHelp, &element.documentation}) {
      const std::size_t mark = property->Text().find('!');
      if (mark != std::string_view::npos) return property->Text().substr(mark, 1);
    }
    return {};
  }

  ElementParts& PartsOf(const CEL_Element& element) {
    return parts.try_emplace(element.GetUid(), element).first->second;
  }

  bool PlaceAt(FilePlace& place, std::string_view part) const {
    const FilePlace found = part.data() == nullptr ? FilePlace{} : lines.PlaceOf(part);
    if (found.line > 0) place = found;
    return found.line > 0;
  }

  FileLines lines;
  ElementIndex elements;
  std::unordered_map<Uid, ElementParts> parts;
};

}  // namespace

void FindPlaces(const TemplateCore& core, TemplateMessages& messages) {
  if (messages.IsClean() && messages.account.empty()) return;
  const ScannerRest rest;
  MessagePlaces places(core);
  for (TemplateMessage& message : messages.errors) places.Place(message);
  for (UndefinedName& undefined : messages.undefined) {
    for (UndefinedName::User& user : undefined.usedBy) places.Place(user, undefined.symbol);
  }
  messages.accountPlaces.clear();
  for (const AccountEntry& entry : messages.account) {
    messages.accountPlaces.push_back(places.PlaceOfLine(entry.line));
  }
}

}  // namespace tessal::cli
