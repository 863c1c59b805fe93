// The tables of a model as text: for a page in Markdown, for a spreadsheet, and for a paper in LaTeX.
#pragma once

#include <span>
#include <string>

#include "docgen/model_tables.h"

namespace tessal {

// Tables that hold nothing are left out, and in Markdown and LaTeX columns without a value in any row.

/// A heading and a table for each.
std::string TablesAsMarkdown(std::span<const ModelTable> tables);

/// Lines of comma-separated values: for each table the names of its columns, then its rows. Several tables
/// have an empty line between them, and their names in a line before.
std::string TablesAsCsv(std::span<const ModelTable> tables);

/// Sections with long tables, for the body of a document with the packages amsmath, array, booktabs and
/// longtable.
std::string TablesAsLatex(std::span<const ModelTable> tables);

/// The same as a document of its own.
std::string TablesAsLatexDocument(std::span<const ModelTable> tables, const std::string& title);

}  // namespace tessal
