// One HTML page that documents a whole template, with every expression as a MathML block.
#pragma once

#include <ctime>
#include <string>

namespace tessal {

class TemplateCore;

/// Writes the page. False, with the reason in words, when not every byte reached the file.
bool ExportHtmlDocumentation(const TemplateCore& core, const std::string& path, bool embedMathJax,
                             std::string& failure);

/// The page as text, created at the given local time.
std::string HtmlDocumentation(const TemplateCore& core, bool embedMathJax, const std::tm& created);

}  // namespace tessal
