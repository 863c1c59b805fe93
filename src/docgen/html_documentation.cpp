#include "docgen/html_documentation.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <filesystem>
#include <span>
#include <string_view>
#include <system_error>
#include <unordered_map>
#include <utility>
#include <vector>

#include "core/template_core.h"
#include "docgen/mathml.h"
#include "docgen/page_style.h"
#include "docgen/safe_text.h"
#include "elements/choices.h"
#include "expr/parser.h"
#include "platform/descriptor.h"
#include "platform/file_replacement.h"
#include "platform/text_encoding.h"

namespace tessal {

namespace {

constexpr std::string_view kProjectAddress = TESSAL_MATHJAX_PROJECT;

// The slash before the public identifier has always been there.
constexpr std::string_view kDoctype =
    "<!DOCTYPE HTML PUBLIC /\"-//W3C//DTD HTML 4.01 Transitional//EN\" "
    "\"http://www.w3.org/TR/html4/loose.dtd\">";

constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";

constexpr std::array<std::string_view, 13> kMiscKeys = {
    "Description",          "Documentation",      "Online help",
    "Tessal version",       "Parser version",     "Randseed",
    "Optimise expressions", "Trigonometric unit", "Revision",
    "Debug level",          "Debug log",          "Inital random particle dir",
    "Build spatial tree"};

// The last key is there twice: an element that has it shows the row twice.
constexpr std::array<std::string_view, 23> kElementKeys = {"ID",
                                                           "Description",
                                                           "Documentation",
                                                           "Online help",
                                                           "Scope",
                                                           "Transport",
                                                           "Spatial Variation",
                                                           "UNQ Type",
                                                           "UNQ Unit",
                                                           "Unit",
                                                           "Is user specified",
                                                           "Build in ID",
                                                           "Default Value",
                                                           "Min Value",
                                                           "Max Value",
                                                           "Expression",
                                                           "Equation",
                                                           "Speed",
                                                           "Direction",
                                                           "horizontal speed equation",
                                                           "horizontal direction equation",
                                                           "vertical speed equation",
                                                           "vertical speed equation"};

/// How the page heads and counts a list of elements.
struct ListCaption {
  ElementKind kind;
  std::string_view count;    ///< in the summary
  std::string_view heading;  ///< empty for a list without a section of its own
};

constexpr std::array<ListCaption, 11> kListCaptions = {{
    {ElementKind::StateVariable, "<li>State variables : ", "<p> <li> <h2>State Variables </h2>"},
    {ElementKind::Constant, "<li>Constants       : ", "<p> <li> <h2> Constants </h2>"},
    {ElementKind::Forcing, "<li>Forcings        : ", "<p> <li> <h2> Forcing </h2>"},
    {ElementKind::Auxiliary, "<li>Auxiliaries     : ", "<p> <li> <h2> Auxilliaries </h2>"},
    {ElementKind::Process, "<li>Processes       : ", "<p> <li> <h2> Process </h2>"},
    {ElementKind::DerivedOutput, "<li>Derived outputs : ", "<p> <li> <h2> Derived Outputs </h2>"},
    {ElementKind::SpecieStateVariable,
     "<li>State variables          : ", "<p> <li> <h2> State Variables </h2>"},
    {ElementKind::SpecieConstant, "<li>Constants                : ", "<p> <li> <h2> Constants</h2>"},
    {ElementKind::SpatialFunction,
     "<li>Spatial functions        : ", "<p> <li> <h2>  Remote Area Search Functions </h2>"},
    {ElementKind::ArithmeticExpression,
     "<li>Arithmetical expressions : ", "<p> <li> <h2> Arithmetic Expressions </h2>"},
    {ElementKind::HorizontalVector, "<li>Horizontal vectors       : ", ""},
}};

/// None for a list that the page leaves out: the forcings of a class.
const ListCaption* CaptionOf(ElementKind kind) {
  const auto hit = std::find_if(kListCaptions.begin(), kListCaptions.end(),
                                [kind](const ListCaption& caption) { return caption.kind == kind; });
  return hit == kListCaptions.end() ? nullptr : &*hit;
}

using Keys = std::span<const std::string_view>;

bool HasUnitName(std::string_view key) {
  return key == "UNQ Type" || key == "UNQ Unit";
}

class PageWriter final {
 public:
  PageWriter(const TemplateCore& templateCore, const PageOptions& pageOptions)
      : core(templateCore), options(pageOptions) {}

  std::string Write(const std::tm& created) {
    WriteHead();
    WriteSummary();
    WriteMisc();
    Line("</div>");
    Line("<div id=left style=background-color:#FFD700;width:35%;float:left;>");
    Line("<h1>Elements</h1>");
    WriteElementSections(false, kElementKeys);
    Line("</div>");
    Line("<div id=right style=background-color:#EEEEEE;width:65%;float:left;>");
    Line("<h1>Details</h1>");
    WriteElementSections(true, kElementKeys);
    Line("</div>");
    WriteFooter(created);
    const bool isAscii = std::none_of(page.begin(), page.end(), [](char each) { return (each & 0x80) != 0; });
    if (!isAscii && IsUtf8(page)) page.insert(0, kUtf8Mark);
    return std::move(page);
  }

 private:
  static constexpr std::string_view kClosing = "</li> </p>";

  void Line(std::string_view text) {
    page += text;
    page += '\n';
  }

  void Count(std::string_view text, std::size_t count) {
    Line(std::string(text) + std::to_string(count) + "</li>");
  }

  void WriteHead() {
    Line(kDoctype);
    Line("<html>");
    Line("<head>");
    const std::string description = Text(core.Root().description.TextOf());
    if (!description.empty()) Line("<title>Model description for " + description + "</title>");
    if (!options.mathJax.empty()) {
      WriteScripts();
      Line("<meta http-equiv=X-UA-Compatible content=IE=EmulateIE7>");
    }
    Line(kPageStyle);
    Line("</head>");
    Line("<body>");
    Line("<div id=container>");
    Line("<div id=header>");
    if (!description.empty()) Line("<h1>Model description for " + description + "</h1>");
    Line("<h2>Template file : " + Text(core.TemplateFileName()) + "</h2>");
    if (!options.mathJax.empty()) Line("<br>This document uses MathML and may render quite slow in IE8!");
  }

  void WriteScripts() {
    // The script of MathJax 2 takes its configuration from the query, and is there twice. One by another name
    // is taken as it is.
    static constexpr std::array<std::string_view, 2> kQueries = {"?config=MML_HTMLorMML", ""};
    const bool isSecond = options.mathJax.ends_with("/MathJax.js");
    for (const std::string_view query : std::span(kQueries).last(isSecond ? 2 : 1)) {
      Line("<script type=text/javascript");
      Line("src=\"" + SafeText(options.mathJax) + std::string(query) + "\">");
      Line("</script>");
    }
  }

  void WriteSummary() {
    Line("<br><h3>Summary</h3>");
    Line("<ul>");
    ForEachHeadedCollection([this](const auto& row) {
      Count(CaptionOf(row.kind)->count, (core.Elements().*row.elements).size());
    });
    if (core.GetSpecieCount() > 0) {
      Count("<li>Species         : ", core.GetSpecieCount());
      Line("<ul>");
      std::size_t number = 0;
      for (const auto& specie : core.Species()) {
        Count("<li>Specie ", ++number);
        ForEachMemberList([this, &specie](const auto& list) {
          const ListCaption* caption = CaptionOf(list.kind);
          if (caption != nullptr) Count(caption->count, ((*specie).*list.members).size());
        });
        Count("<li>Vertical vectors         : ", 1);
      }
      Line("</ul>");
    }
    Line("</ul> <br>");
  }

  void WriteMisc() {
    const CEL_Miscanellous* misc = core.GetMisc();
    if (misc == nullptr) return;
    Line("<hr>");
    Line("<p><h3>Miscellaneous</h3>");
    WriteElementEntry(*misc, true, kMiscKeys, false);
    Line("</p>");
  }

  void WriteFooter(const std::tm& created) {
    constexpr std::size_t kTimeLength = 26;
    Line("<div id=footer>");
    Line("<hr>");
    // The same words in every language of the system, with a line break of their own at the end.
    std::array<char, kTimeLength> time{};
    if (asctime_r(&created, time.data()) != nullptr) {
      page += "<br>Document created : ";
      Line(time.data());
    }
    if (!options.mathJax.empty()) {
      Line("<br>Math rendered by <a href=\"" + std::string(kProjectAddress) + "\">MathJax</a>");
    }
    for (const std::string_view end : {"</div>", "</div>", "</body>", "</html>"}) Line(end);
  }

  template <class Elements>
  void WriteEntries(const Elements& elements, bool detail, Keys keys) {
    for (const auto& element : elements) WriteElementEntry(*element, detail, keys, true);
  }

  template <class Elements>
  void WriteCollection(ElementKind kind, const Elements& elements, bool detail, Keys keys) {
    const ListCaption* caption = CaptionOf(kind);
    if (caption == nullptr || caption->heading.empty()) return;
    Line("<hr>");
    Line(caption->heading);
    if (elements.empty()) Line("-none- <br>");
    WriteEntries(elements, detail, keys);
    // The page has always had a blank here, and here alone.
    Line(kind == ElementKind::StateVariable ? " </li> </p>" : kClosing);
  }

  void WriteElementSections(bool detail, Keys keys) {
    Line("<ul>");
    ForEachHeadedCollection([this, detail, keys](const auto& row) {
      WriteCollection(row.kind, core.Elements().*row.elements, detail, keys);
    });
    if (core.GetSpecieCount() > 0) {
      Line("<hr>");
      Line("<p> <h2>Lagrange particle classes</h2>");
      Line("<ul>");
      for (const auto& specie : core.Species()) WriteSpecie(*specie, detail, keys);
      Line("</p>");
    }
    Line("</ul>");
  }

  void WriteSpecie(const CEL_Lagrange_Specie& specie, bool detail, Keys keys) {
    Line("<li> <h2> Particle Class &quot" + Text(specie.symbol.TextOf()) + "&quot</h2>");
    WriteElementEntry(specie, detail, keys, true);
    ForEachMemberList([this, &specie, detail, keys](const auto& list) {
      WriteCollection(list.kind, specie.*list.members, detail, keys);
    });
    Line("<hr>");
    Line("<p> <ul> <h2> Movement </h2>");
    Line("<p> <li> <h3> Horizontal Vectors</h3>");
    WriteEntries(specie.horizontalVectors, detail, keys);
    Line(kClosing);
    Line("<li><h3> Vertical Vector </h3>");
    WriteElementEntry(*specie.verticalEquation, detail, keys, true);
    Line("</li>");
    Line("</ul> </p>");
    Line("</ul>");
  }

  /// A text of the template as the page has it.
  std::string Text(const std::string& text) const { return options.isSafe ? SafeText(text) : text; }

  /// An attribute that names the anchor of an element.
  std::string Attribute(std::string_view start, const CEL_Element& element, const std::string& symbol) {
    if (!options.isSafe) return std::string(start) + "ref_" + symbol;
    const std::size_t name = start.find('=') + 1;
    return std::string(start.substr(0, name)) + '"' + std::string(start.substr(name)) + "ref_" +
           SafeAnchor(element, symbol) + '"';
  }

  /// A name that no other element has, also where two have one symbol.
  const std::string& SafeAnchor(const CEL_Element& element, const std::string& symbol) {
    std::string& anchor = anchors[&element];
    if (anchor.empty()) {
      const std::string text = AnchorText(symbol);
      const std::size_t number = ++anchorCounts[text];
      anchor = number == 1 ? text : text + "--" + std::to_string(number);
    }
    return anchor;
  }

  /// The symbol that an element's anchor is named after: its symbol field, or, for a movement, which has
  /// none, the composed symbol.
  std::string AnchorSymbol(const CEL_Element& element, const std::vector<ElementField>& fields) const {
    if (const ElementField* symbol = FindField(fields, "Symbol")) return symbol->text;
    const bool isMovement =
        element.Kind() == ElementKind::HorizontalVector || element.Kind() == ElementKind::VerticalEquation;
    const SymbolRecord* record = isMovement ? core.RecordOfElement(element) : nullptr;
    return record == nullptr ? std::string() : core.RecordSymbol(*record);
  }

  /// The block of an expression field, from the parse that its element holds.
  static std::string MathMLOf(const CEL_Element& element, const ElementField& field,
                              const std::string& symbol, bool isDerivative) {
    const ParsedExpression* parsed = nullptr;
    element.ForEachExpression([&field, &parsed](const PropertyRow& row, const CEL_Property& expression) {
      // The page takes a text as it is, quotes and all; the held parse is without them.
      if (row.label == field.name && field.text.find('"') == std::string::npos) parsed = &expression.Parsed();
    });
    if (parsed == nullptr) return ExpressionToMathML(field.text, symbol, isDerivative);
    return parsed->Tree() == nullptr ? std::string() : TreeToMathML(*parsed->Tree(), symbol, isDerivative);
  }

  void WriteElementEntry(const CEL_Element& element, bool detail, Keys keys, bool withReferences) {
    std::vector<ElementField> fields;
    element.GetFields(fields);
    Line("<ul><li>");
    const std::string symbol = AnchorSymbol(element, fields);
    if (!symbol.empty()) {
      Line("<h4> <a " + Attribute(detail ? "id=" : "href=#", element, symbol) + ">" + Text(symbol) +
           "</a></h4>");
    }
    if (detail) {
      Line("<table border=0 > ");
      Line("<colgroup> <col width=30%> <col width=70%> </colgroup> ");
      for (const std::string_view key : keys) WriteRow(element, fields, key, symbol);
      if (withReferences) WriteReferences(element);
      Line("</table> ");
    }
    Line("</li></ul>");
  }

  void WriteRow(const CEL_Element& element, const std::vector<ElementField>& fields, std::string_view key,
                const std::string& symbol) {
    const ElementField* field = FindField(fields, key);
    if (field == nullptr) return;
    Line("<tr>");
    Line("<td>");
    Line(field->name);
    Line("</td>");
    Line("<td>");
    if (field->kind == FieldKind::Expression) {
      const bool isDerivative =
          element.Kind() == ElementKind::StateVariable || element.Kind() == ElementKind::SpecieStateVariable;
      Line(MathMLOf(element, *field, Text(symbol), isDerivative));
    } else {
      Line(Text(FieldText(*field)));
    }
    std::string unitName;
    if (HasUnitName(key) && unqGetItemTypeKey(field->intValue, unitName) != 0) Line(" (" + unitName + ")");
    Line("</td>");
    Line("</tr> ");
  }

  void WriteReferences(const CEL_Element& element) {
    Line("<tr>");
    Line("<td>");
    Line("Referenced by");
    Line("</td>");
    Line("<td>");
    std::string links;
    if (const SymbolRecord* record = core.RecordOfElement(element)) {
      const CEL_Element* previous = nullptr;
      for (const std::uint32_t sequence : record->referencedBy) {
        const SymbolRecord& user = *core.FindRecordBySequence(sequence);
        // The two records of a movement are side by side.
        if (std::exchange(previous, user.element) == user.element) continue;
        const std::string name = core.RecordSymbol(user);
        if (!links.empty()) links += ", ";
        links += "<a " + Attribute("href=#", *user.element, name) + ">" + Text(name) + "</a>";
      }
    }
    Line(links.empty() ? "- not used -" : links);
    Line("</td>");
    Line("</tr> ");
  }

  const TemplateCore& core;
  const PageOptions& options;
  std::string page;
  /// Of safe pages: the anchors so far by element, and how many elements share a name.
  std::unordered_map<const CEL_Element*, std::string> anchors;
  std::unordered_map<std::string, std::size_t> anchorCounts;
};

}  // namespace

std::string_view UsualMathJax() {
  return TESSAL_MATHJAX_ADDRESS;
}

std::string HtmlDocumentation(const TemplateCore& core, const PageOptions& options, const std::tm& created) {
  return PageWriter(core, options).Write(created);
}

std::string UsualPagePath(const std::string& templateFile) {
  const std::filesystem::path file(templateFile);
  return (file.parent_path() / "HTML_doc" / file.filename().replace_extension(".html")).string();
}

std::optional<std::string> PrepareUsualPagePath(const std::string& templateFile, std::string& failure) {
  std::string page = UsualPagePath(templateFile);
  const std::filesystem::path folder = std::filesystem::path(page).parent_path();
  std::error_code shownByTheWrite;
  std::filesystem::create_directory(folder, shownByTheWrite);
  if (std::filesystem::is_symlink(std::filesystem::symlink_status(folder, shownByTheWrite))) {
    failure = "can not write into '" + folder.string() + "': it is a symbolic link";
  } else if (IsStream(page)) {
    failure = "can not replace '" + page + "': it is no plain file";
  } else {
    failure = PageRefusal(page);
  }
  return failure.empty() ? std::optional(std::move(page)) : std::nullopt;
}

std::string PageRefusal(const std::string& path) {
  std::error_code shownByTheWrite;
  if (!std::filesystem::is_regular_file(std::filesystem::symlink_status(path, shownByTheWrite))) return {};
  const Descriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC));
  std::string start(kUtf8Mark.size() + kDoctype.size(), '\0');
  const ssize_t count = read(file.Number(), start.data(), start.size());
  if (count < 0) return "'" + path + "' exists already and can not be read";
  start.resize(static_cast<std::size_t>(count));
  if (start.starts_with(kUtf8Mark)) start.erase(0, kUtf8Mark.size());
  return start.empty() || start.starts_with(kDoctype)
             ? std::string()
             : "'" + path + "' exists already and is no page of this program";
}

std::string HtmlDocumentation(const TemplateCore& core, const PageOptions& options) {
  const std::time_t now = std::time(nullptr);
  std::tm local = {};
  localtime_r(&now, &local);
  return HtmlDocumentation(core, options, local);
}

bool ExportHtmlDocumentation(const TemplateCore& core, const std::string& path, const PageOptions& options,
                             std::string& failure) {
  std::error_code notThere;
  if (std::filesystem::equivalent(path, core.TemplateFileName(), notThere)) {
    failure = "can not write the page over its template '" + path + "'";
    return false;
  }
  failure = WriteOutputFile(path, HtmlDocumentation(core, options));
  return failure.empty();
}

}  // namespace tessal
