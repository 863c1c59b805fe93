// The messages of a check at their places, as an editor lists them.
#include <string>
#include <unordered_map>
#include <vector>

#include "analysis/all_findings.h"
#include "cli/finding_report.h"
#include "cli/lsp/features.h"
#include "cli/lsp/symbol_places.h"
#include "core/messages.h"

namespace tessal::cli {

namespace {

enum Severity : int { kError = 1, kWarning = 2, kInformation = 3, kHint = 4 };
enum Tag : int { kUnnecessary = 1, kDeprecated = 2 };

Severity SeverityOf(std::uint32_t level) {
  switch (static_cast<ErrorLevel>(level)) {
    case ErrorLevel::Notice:
      return kInformation;
    case ErrorLevel::Warning:
      return kWarning;
    default:
      // A name that nobody has defined is an error, too.
      return kError;
  }
}

Json DiagnosticAt(Json range, Severity severity, std::string_view code, std::string text) {
  Json diagnostic = {{"range", std::move(range)},
                     {"severity", severity},
                     {"code", code},
                     {"source", "tessal"},
                     {"message", std::move(text)}};
  if (code.starts_with("unused-")) diagnostic["tags"] = {kUnnecessary};
  if (code.find("deprecated") != std::string_view::npos) diagnostic["tags"] = {kDeprecated};
  return diagnostic;
}

std::string TextOf(std::string_view symbol, std::string_view text) {
  return symbol.empty() ? std::string(text) : std::string(symbol) + ": " + std::string(text);
}

/// The elements by their symbols. Of those that share one the first counts.
class ElementsByName final {
 public:
  explicit ElementsByName(const TemplateCore& core) {
    ForEachElement(
        core, [this](const CEL_Element& element) { elements.try_emplace(element.symbol.Text(), &element); });
  }

  const CEL_Element* Find(std::string_view name) const {
    const auto hit = elements.find(name);
    return hit == elements.end() ? nullptr : hit->second;
  }

 private:
  std::unordered_map<std::string_view, const CEL_Element*> elements;
};

/// Where the name that a message is about is defined.
void AddRelated(const LoadedDocument& document, const ElementsByName& elements, const std::string& name,
                Json& diagnostic) {
  const CEL_Element* element = name.empty() ? nullptr : elements.Find(name);
  const std::string_view definition =
      element == nullptr ? std::string_view() : DefinitionOf(document, *element);
  if (definition.empty()) return;
  diagnostic["relatedInformation"] =
      Json::array({{{"location", LocationOf(document, definition)}, {"message", name + " is defined here"}}});
}

Json ListOf(const LoadedDocument& document) {
  Json list = Json::array();
  const TemplateMessages& messages = document.Messages();
  const ElementsByName elements(document.Core());
  for (const TemplateMessage& message : messages.errors) {
    // What is about the file itself has a heading in the place of a symbol.
    const bool isOfElement = message.kind != ElementKind::None;
    Json diagnostic = DiagnosticAt(document.RangeOf(message.place), SeverityOf(message.level), message.code,
                                   isOfElement ? TextOf(message.symbol, message.text) : message.text);
    AddRelated(document, elements, message.name, diagnostic);
    list.push_back(std::move(diagnostic));
  }
  for (const UndefinedName& undefined : messages.undefined) {
    const Finding finding("undefined-symbol", {undefined.symbol});
    for (const UndefinedName::User& user : undefined.usedBy) {
      const std::vector<FilePlace> places =
          user.uses.empty() ? std::vector<FilePlace>{user.place} : user.uses;
      for (const FilePlace& place : places) {
        list.push_back(DiagnosticAt(document.RangeOf(place), kError, finding.message->code,
                                    TextOf(user.symbol, finding.text)));
      }
    }
  }
  for (std::size_t index = 0; index < messages.account.size(); ++index) {
    const AccountEntry& entry = messages.account[index];
    const FilePlace place =
        index < messages.accountPlaces.size() ? messages.accountPlaces[index] : FilePlace{entry.line};
    list.push_back(
        DiagnosticAt(document.RangeOf(place), kInformation, entry.code, TextOf(entry.symbol, entry.text)));
  }
  return list;
}

Json ParamsWith(const LoadedDocument& document, Json list) {
  Json params = {{"uri", document.Document().uri}};
  if (!document.Document().version.is_null()) params["version"] = document.Document().version;
  params["diagnostics"] = std::move(list);
  return params;
}

}  // namespace

Json Diagnostics(const LoadedDocument& document) {
  return ParamsWith(document, ListOf(document));
}

Json DiagnosticsWithAnalyses(const LoadedDocument& document) {
  Json list = ListOf(document);
  if (document.IsLoaded()) {
    const FileReport report =
        ReportOf(document.Document().uri, document.Core(), AllFindings(document.Core()));
    for (const ReportedFinding& finding : report.findings) {
      list.push_back(DiagnosticAt(document.RangeOf(finding.place), kHint, finding.code,
                                  TextOf(finding.symbol, finding.text)));
    }
  }
  return ParamsWith(document, std::move(list));
}

}  // namespace tessal::cli
