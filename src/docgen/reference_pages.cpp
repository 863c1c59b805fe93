#include "docgen/reference_pages.h"

#include <algorithm>

#include "docgen/safe_text.h"
#include "expr/builtin_reference.h"
#include "expr/function_catalogue.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

constexpr std::string_view kResult = "Result";
constexpr std::string_view kFormulae = "Formulae";

constexpr std::string_view kFunctionIntroduction =
    "The functions that an expression may call. Names may be written in any case; all arguments have to be "
    "given, separated by commas. A unit of 1 means a plain number. Angles of the trigonometric functions are "
    "in "
    "the unit that the template's settings name.";
constexpr std::string_view kBuiltinIntroduction =
    "The quantities that the simulation engine supplies by itself. A constant or forcing of a template takes "
    "one "
    "of them over with its unit, scope, spatial variation and limits; expressions use it by the element's "
    "own "
    "symbol.";

/// What only the engine can compute has no value here.
bool IsOfTheEngine(const CatalogueFunction& function) {
  return function.evaluator == nullptr || function.traits.needsEngine;
}

void AddFact(ReferenceEntry& entry, std::string_view label, std::string_view text) {
  if (!text.empty()) entry.facts.push_back({label, std::string(text)});
}

std::string LimitText(double limit) {
  constexpr double kNoLimit = 1e+08;
  return limit >= kNoLimit || limit <= -kNoLimit ? "none" : ShortestNumberText(limit);
}

/// The name that a page of Markdown gives to a heading.
std::string MarkdownAnchor(std::string_view heading) {
  std::string anchor;
  for (const char character : heading) {
    if (character == ' ') anchor += '-';
    if (character >= 'A' && character <= 'Z') {
      anchor += static_cast<char>(character - 'A' + 'a');
    } else if (character != ' ' && character != ':' && character != ',') {
      anchor += character;
    }
  }
  return anchor;
}

ReferenceSection SectionOf(std::string_view title, std::span<const WordReference> words) {
  ReferenceSection section{title, {}};
  for (const WordReference& word : words) section.entries.push_back(EntryOf(word));
  return section;
}

std::string Element(std::string_view tag, std::string_view content) {
  return "<" + std::string(tag) + ">" + std::string(content) + "</" + std::string(tag) + ">";
}

/// A section's anchor is in capitals, as those of the names are.
std::string SectionAnchor(std::string_view title) {
  std::string anchor = MarkdownAnchor(title);
  std::transform(anchor.begin(), anchor.end(), anchor.begin(), [](char character) {
    return character >= 'a' && character <= 'z' ? static_cast<char>(character - 'a' + 'A') : character;
  });
  return anchor;
}

std::string Heading(std::string_view tag, const std::string& anchor, std::string_view text) {
  return Element(tag, "<a name=\"" + anchor + "\" id=\"" + anchor + "\"></a>" + SafeText(text)) + "\n";
}

/// A link to a place on the same page.
std::string LinkTo(std::string_view anchor, std::string_view text) {
  return "<a href=\"#" + std::string(anchor) + "\">" + SafeText(text) + "</a>";
}

}  // namespace

ReferenceEntry EntryOf(const FunctionReference& function) {
  ReferenceEntry entry{.name = std::string(function.name),
                       .heading = CallText(function),
                       .purpose = function.purpose,
                       .quantities = {},
                       .facts = {},
                       .formulae = FormulaeOf(function)};
  for (const ArgumentReference& argument : function.arguments) {
    entry.quantities.push_back({argument.name, argument.meaning, UnitInWords(function, argument.unit)});
  }
  entry.quantities.push_back({kResult, function.result, UnitInWords(function, function.resultUnit)});
  AddFact(entry, "Range", function.range);
  AddFact(entry, "Source", function.source);
  const CatalogueFunction* row = FindFunction(function.name);
  if (IsOfTheEngine(*row)) AddFact(entry, "Computed by", "the simulation engine alone");
  if (row->traits.isDeprecated) AddFact(entry, "Deprecated", "not for new templates");
  return entry;
}

ReferenceEntry EntryOf(const CatalogueBuiltin& builtin) {
  const BuiltinReference& reference = *ReferenceOfBuiltin(builtin.name);
  ReferenceEntry entry{.name = std::string(builtin.name),
                       .heading = std::string(builtin.name),
                       .purpose = reference.purpose,
                       .quantities = {},
                       .facts = {},
                       .formulae = {}};
  AddFact(entry, "Good for", reference.use);
  AddFact(entry, "Kind", builtin.kind == 1 ? "constant" : "forcing");
  AddFact(entry, "Unit", builtin.unit.empty() ? "1" : builtin.unit);
  AddFact(entry, "Scope", LayerText(builtin.layer));
  AddFact(entry, "Spatial variation", VariationText(builtin.variation));
  AddFact(entry, "Default", ShortestNumberText(builtin.defaultValue));
  AddFact(entry, "Limits", LimitText(builtin.minimum) + " to " + LimitText(builtin.maximum));
  if (IsDeprecatedBuiltin(builtin.id)) AddFact(entry, "Deprecated", "not for new templates");
  return entry;
}

ReferenceEntry EntryOf(const WordReference& word) {
  ReferenceEntry entry{.name = std::string(word.word),
                       .heading = std::string(word.word),
                       .purpose = word.meaning,
                       .quantities = {},
                       .facts = {},
                       .formulae = {}};
  AddFact(entry, "Unit", word.unit);
  return entry;
}

std::string EntryText(const ReferenceEntry& entry) {
  std::string text = entry.heading + "\n" + std::string(entry.purpose) + "\n";
  for (const ReferenceEntry::Quantity& quantity : entry.quantities) {
    text += "  " + std::string(quantity.name) + ": " + std::string(quantity.meaning) + " [" + quantity.unit +
            "]\n";
  }
  for (const ReferenceEntry::Fact& fact : entry.facts) {
    text += "  " + std::string(fact.label) + ": " + fact.text + "\n";
  }
  for (std::size_t place = 0; place < entry.formulae.size(); ++place) {
    text += "  Option " + std::to_string(place + 1) + ": " + std::string(entry.formulae[place]) + "\n";
  }
  return text;
}

std::string EntryMarkdown(const ReferenceEntry& entry) {
  std::string text = "### " + entry.name + "\n\n";
  if (entry.heading != entry.name) text += "`" + entry.heading + "`\n\n";
  text += MarkdownText(entry.purpose) + "\n";
  if (!entry.quantities.empty()) text += "\n| | Meaning | Unit |\n|---|---|---|\n";
  for (const ReferenceEntry::Quantity& quantity : entry.quantities) {
    const bool isResult = &quantity == &entry.quantities.back();
    text += isResult ? "| **" + std::string(quantity.name) + "** | "
                     : "| `" + std::string(quantity.name) + "` | ";
    text += MarkdownText(quantity.meaning) + " | " + MarkdownText(quantity.unit) + " |\n";
  }
  for (const ReferenceEntry::Fact& fact : entry.facts) {
    text += "\n**" + std::string(fact.label) + ":** " + MarkdownText(fact.text) + "\n";
  }
  if (!entry.formulae.empty()) text += "\n**" + std::string(kFormulae) + ":**\n\n";
  for (std::size_t place = 0; place < entry.formulae.size(); ++place) {
    text += std::to_string(place + 1) + ". " + MarkdownText(entry.formulae[place]) + "\n";
  }
  return text;
}

std::string EntryHtml(const ReferenceEntry& entry) {
  std::string html =
      Heading("h3", AnchorText(entry.name), entry.heading) + Element("p", SafeText(entry.purpose)) + "\n";
  if (!entry.quantities.empty()) {
    html += "<table border=\"1\" cellspacing=\"0\" cellpadding=\"4\">\n";
    for (const ReferenceEntry::Quantity& quantity : entry.quantities) {
      html += Element("tr", Element("td", Element("b", SafeText(quantity.name))) +
                                Element("td", SafeText(quantity.meaning)) +
                                Element("td", SafeText(quantity.unit))) +
              "\n";
    }
    html += "</table>\n";
  }
  for (const ReferenceEntry::Fact& fact : entry.facts) {
    html += Element("p", Element("b", SafeText(fact.label)) + ": " + SafeText(fact.text)) + "\n";
  }
  if (entry.formulae.empty()) return html;
  html += Element("p", Element("b", kFormulae)) + "\n<ol>\n";
  for (const std::string_view formula : entry.formulae) html += Element("li", SafeText(formula)) + "\n";
  return html + "</ol>\n";
}

ReferencePage PageOfFunctions() {
  ReferencePage page{"Functions", kFunctionIntroduction, {}};
  for (const FunctionGroup& group : FunctionGroups()) {
    ReferenceSection& section = page.sections.emplace_back(ReferenceSection{group.title, {}});
    for (const FunctionReference& function : group.functions) section.entries.push_back(EntryOf(function));
  }
  page.sections.push_back(SectionOf("Properties of particles, in square brackets", PropertyReferences()));
  page.sections.push_back(SectionOf("Interactions of particles", VerbReferences()));
  return page;
}

ReferencePage PageOfBuiltins() {
  struct Kind {
    std::string_view title;
    const std::vector<std::int32_t>& ids;
  };
  ReferencePage page{"Built-in quantities", kBuiltinIntroduction, {}};
  for (const Kind& kind : {Kind{"Constants", ConstantBuiltinIds()}, Kind{"Forcings", ForcingBuiltinIds()}}) {
    ReferenceSection& section = page.sections.emplace_back(ReferenceSection{kind.title, {}});
    for (const std::int32_t id : kind.ids) {
      CatalogueBuiltin builtin;
      GetBuiltinById(id, builtin);
      section.entries.push_back(EntryOf(builtin));
    }
  }
  return page;
}

std::string PageMarkdown(const ReferencePage& page) {
  std::string text = "# " + std::string(page.title) + "\n\n" + MarkdownText(page.introduction) + "\n\n";
  for (const ReferenceSection& section : page.sections) {
    text += "- [" + std::string(section.title) + "](#" + MarkdownAnchor(section.title) + "):";
    for (const ReferenceEntry& entry : section.entries) {
      text += " [" + MarkdownText(entry.name) + "](#" + MarkdownAnchor(entry.name) + ")";
    }
    text += "\n";
  }
  for (const ReferenceSection& section : page.sections) {
    text += "\n## " + std::string(section.title) + "\n";
    for (const ReferenceEntry& entry : section.entries) text += "\n" + EntryMarkdown(entry);
  }
  return text;
}

std::string PageHtml(const ReferencePage& page) {
  std::string html =
      "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n" +
      Element("title", page.title) +
      "\n<style>\nbody { font-family: sans-serif; margin: 1.5em; }\nh2 { margin-top: 1.5em; }\n</style>\n"
      "</head>\n<body>\n" +
      Element("h1", page.title) + "\n" + Element("p", SafeText(page.introduction)) + "\n<ul>\n";
  for (const ReferenceSection& section : page.sections) {
    std::string links = Element("b", SafeText(section.title)) + ":";
    for (const ReferenceEntry& entry : section.entries) {
      links += "\n" + LinkTo(AnchorText(entry.name), entry.name);
    }
    html += Element("li", links) + "\n";
  }
  html += "</ul>\n";
  for (const ReferenceSection& section : page.sections) {
    html += Heading("h2", SectionAnchor(section.title), section.title);
    for (const ReferenceEntry& entry : section.entries) html += EntryHtml(entry);
  }
  return html + "</body>\n</html>\n";
}

}  // namespace tessal
