#include "docgen/table_text.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <string_view>
#include <vector>

#include "docgen/csv_text.h"
#include "docgen/latex.h"
#include "docgen/safe_text.h"

namespace tessal {

namespace {

using Columns = std::vector<std::size_t>;

/// The columns that have a value in a row, the first one always.
Columns ColumnsInUse(const ModelTable& table) {
  Columns used;
  for (std::size_t column = 0; column < table.columns.size(); ++column) {
    const bool isUsed = std::any_of(table.rows.begin(), table.rows.end(),
                                    [column](const auto& row) { return !row[column].empty(); });
    if (isUsed || column == 0) used.push_back(column);
  }
  return used;
}

// Markdown.

/// A text between backticks, which shows it as it is.
std::string CodeSpan(const std::string& text) {
  if (text.find('`') != std::string::npos) return MarkdownText(text);
  std::string span = "`";
  for (const char character : text) {
    // A bar ends a cell even there.
    if (character == '|') span += '\\';
    span += character;
  }
  return span + '`';
}

std::string MarkdownCell(const ModelTable& table, const std::vector<std::string>& row, std::size_t column) {
  const std::string& text = row[column];
  const CellKind kind = table.columns[column].kind;
  if (text.empty()) return {};
  if (kind == CellKind::Derivative) return CodeSpan("d " + row.front() + "/dt = " + text);
  return kind == CellKind::Symbol || kind == CellKind::Expression ? CodeSpan(text) : MarkdownText(text);
}

void AppendMarkdownTable(std::string& page, const ModelTable& table) {
  page += "\n|";
  const Columns columns = ColumnsInUse(table);
  for (const std::size_t column : columns) {
    const TableColumn& head = table.columns[column];
    page += " " + (head.isSymbol ? CodeSpan(head.name) : MarkdownText(head.name)) + " |";
  }
  page += "\n|";
  for (const std::size_t column : columns) {
    page += table.columns[column].kind == CellKind::Number ? " ---: |" : " --- |";
  }
  page += "\n";
  for (const auto& row : table.rows) {
    page += "|";
    for (const std::size_t column : columns) page += " " + MarkdownCell(table, row, column) + " |";
    page += "\n";
  }
}

void AppendMarkdown(std::string& page, const ModelTable& table) {
  page += (page.empty() ? "## " : "\n## ") + MarkdownText(table.title) + "\n";
  if (!table.rows.empty()) AppendMarkdownTable(page, table);
  for (const std::string& note : table.notes) page += "\n" + MarkdownText(note) + "\n";
}

// LaTeX.

/// As a formula; a text that is no expression of the language as it is.
std::string Formula(const std::string& expression, const std::string& symbol) {
  const std::string latex = ExpressionToLatex(expression, symbol, !symbol.empty());
  return latex.empty() ? LatexText(expression) : "$" + latex + "$";
}

std::string LatexCell(const ModelTable& table, const std::vector<std::string>& row, std::size_t column) {
  const std::string& text = row[column];
  const CellKind kind = table.columns[column].kind;
  if (text.empty()) return {};
  if (kind == CellKind::Text) return LatexText(text);
  return Formula(text, kind == CellKind::Derivative ? row.front() : "");
}

/// How many characters a line of the document has, about.
constexpr double kLine = 100;
/// Longer cells may need several lines.
constexpr std::size_t kShortCell = 14;

std::size_t LongestCell(const ModelTable& table, std::size_t column) {
  std::size_t longest = table.columns[column].name.size();
  for (const auto& row : table.rows) longest = std::max(longest, row[column].size());
  return longest;
}

/// The columns of a table as LaTeX declares them: short ones as wide as they are, the rest of the line for
/// those that may need several lines.
std::string LatexColumns(const ModelTable& table, const Columns& columns) {
  constexpr double kGap = 1.5;
  constexpr double kNarrowest = 0.15;
  const auto isShort = [&table](std::size_t column) {
    const CellKind kind = table.columns[column].kind;
    return kind == CellKind::Symbol || kind == CellKind::Number || LongestCell(table, column) <= kShortCell;
  };
  double taken = 0;
  double wide = 0;
  for (const std::size_t column : columns) {
    taken += kGap + (isShort(column) ? static_cast<double>(LongestCell(table, column)) : 0);
    wide += isShort(column) ? 0 : 1;
  }
  const double share = std::max(kNarrowest, (1 - taken / kLine) / std::max(wide, 1.0));
  constexpr int kPercent = 100;
  const int percent = static_cast<int>(share * kPercent);
  const std::string paragraph = ">{\\raggedright\\arraybackslash}p{0." +
                                std::string(percent < kPercent / 10 ? "0" : "") +
                                std::to_string(std::min(percent, kPercent - 1)) + "\\linewidth}";
  std::string declared;
  for (const std::size_t column : columns) {
    declared += table.columns[column].kind == CellKind::Number ? "r" : isShort(column) ? "l" : paragraph;
  }
  return declared;
}

/// One table of the columns, with the rows that have a value in one of them beside the first.
void AppendLatexTable(std::string& text, const ModelTable& table, const Columns& columns) {
  if (table.rows.empty()) return;
  text += "\\begin{longtable}[l]{@{}" + LatexColumns(table, columns) + "@{}}\n\\toprule\n";
  for (const std::size_t column : columns) {
    const TableColumn& head = table.columns[column];
    text += (column == columns.front() ? "" : " & ") +
            (head.isSymbol ? Formula(head.name, "") : LatexText(head.name));
  }
  text += " \\\\\n\\midrule\n\\endhead\n\\bottomrule\n\\endfoot\n";
  for (const auto& row : table.rows) {
    const bool hasValue = std::any_of(columns.begin() + 1, columns.end(),
                                      [&row](std::size_t column) { return !row[column].empty(); });
    if (!hasValue && columns.size() > 1) continue;
    for (const std::size_t column : columns) {
      text += (column == columns.front() ? "" : " & ") + LatexCell(table, row, column);
    }
    text += " \\\\\n";
  }
  text += "\\end{longtable}\n";
}

/// A table of many formulae has a column for each state variable: parts of it follow one another.
void AppendLatex(std::string& text, const ModelTable& table) {
  constexpr std::size_t kColumnsOfPart = 6;
  text += "\n\\section*{" + LatexText(table.title) + "}\n";
  const Columns columns = ColumnsInUse(table);
  const bool isMatrix = columns.size() > 1 && table.columns[columns.back()].isSymbol;
  const std::size_t size = isMatrix ? kColumnsOfPart : std::max<std::size_t>(columns.size(), 1);
  for (std::size_t first = 1; first == 1 || first < columns.size(); first += size) {
    Columns part{columns.front()};
    for (std::size_t place = first; place < std::min(first + size, columns.size()); ++place) {
      part.push_back(columns[place]);
    }
    AppendLatexTable(text, table, part);
  }
  for (const std::string& note : table.notes) text += LatexText(note) + "\n\n";
}

/// A letter beyond those that the fonts of LaTeX have, as a command.
struct Sign {
  std::string_view sign;  ///< in UTF-8
  std::string_view code;
  std::string_view command;
};

constexpr std::array<Sign, 34> kSigns = {{
    {"α", "03B1", "\\alpha"},  {"β", "03B2", "\\beta"},    {"γ", "03B3", "\\gamma"},
    {"δ", "03B4", "\\delta"},  {"ε", "03B5", "\\epsilon"}, {"ζ", "03B6", "\\zeta"},
    {"η", "03B7", "\\eta"},    {"θ", "03B8", "\\theta"},   {"κ", "03BA", "\\kappa"},
    {"λ", "03BB", "\\lambda"}, {"μ", "03BC", "\\mu"},      {"ν", "03BD", "\\nu"},
    {"ξ", "03BE", "\\xi"},     {"π", "03C0", "\\pi"},      {"ρ", "03C1", "\\rho"},
    {"σ", "03C3", "\\sigma"},  {"τ", "03C4", "\\tau"},     {"φ", "03C6", "\\phi"},
    {"χ", "03C7", "\\chi"},    {"ψ", "03C8", "\\psi"},     {"ω", "03C9", "\\omega"},
    {"Δ", "0394", "\\Delta"},  {"Θ", "0398", "\\Theta"},   {"Σ", "03A3", "\\Sigma"},
    {"Ω", "03A9", "\\Omega"},  {"₂", "2082", "_2"},        {"₃", "2083", "_3"},
    {"₄", "2084", "_4"},       {"⁻", "207B", "^{-}"},      {"−", "2212", "-"},
    {"≤", "2264", "\\leq"},    {"≥", "2265", "\\geq"},     {"→", "2192", "\\rightarrow"},
    {"∞", "221E", "\\infty"},
}};

/// Whether a template has nothing for a table.
bool HasNothing(const ModelTable& table) {
  return table.rows.empty() && table.notes.empty();
}

}  // namespace

std::string TablesAsMarkdown(std::span<const ModelTable> tables) {
  std::string page;
  for (const ModelTable& table : tables) {
    if (!HasNothing(table)) AppendMarkdown(page, table);
  }
  return page;
}

std::string TablesAsCsv(std::span<const ModelTable> tables) {
  std::string text;
  for (const ModelTable& table : tables) {
    if (tables.size() > 1 && table.rows.empty()) continue;
    if (!text.empty()) text += "\r\n";
    if (tables.size() > 1) text += CsvField(table.name) + "\r\n";
    std::vector<std::string> names;
    for (const TableColumn& column : table.columns) names.push_back(column.name);
    text += CsvLine(names);
    for (const auto& row : table.rows) text += CsvLine(row);
  }
  return text;
}

std::string TablesAsLatex(std::span<const ModelTable> tables) {
  std::string text;
  for (const ModelTable& table : tables) {
    if (!HasNothing(table)) AppendLatex(text, table);
  }
  return text;
}

std::string TablesAsLatexDocument(std::span<const ModelTable> tables, const std::string& title) {
  const std::string body = TablesAsLatex(tables);
  std::string text =
      "\\documentclass{article}\n"
      "\\ifdefined\\directlua\\else\\ifdefined\\XeTeXversion\\else\\usepackage[T1]{fontenc}\\fi\\fi\n"
      "\\usepackage{amsmath,array,booktabs,longtable}\n"
      "\\usepackage[margin=2cm]{geometry}\n"
      "\\setlength{\\tabcolsep}{3pt}\n";
  for (const Sign& row : kSigns) {
    if (body.find(row.sign) == std::string::npos) continue;
    text += "\\ifdefined\\DeclareUnicodeCharacter\\DeclareUnicodeCharacter{" + std::string(row.code) +
            "}{\\ensuremath{" + std::string(row.command) + "}}\\fi\n";
  }
  return text + "\\begin{document}\n\\small\n\\title{" + LatexText(title) + "}\n\\author{}\n\\maketitle\n" +
         body + "\\end{document}\n";
}

}  // namespace tessal
