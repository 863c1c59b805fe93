// One HTML page that documents a whole template, with every expression as a MathML block.
#pragma once

#include <ctime>
#include <string>

namespace tessal {

class TemplateCore;

/// Where the page of a template file goes when nobody names a place: the folder `HTML_doc` beside the file,
/// and in it the file's plain name.
std::string UsualPagePath(const std::string& templateFile);

/// The same, with the folder made; one that cannot be made shows when the page is written.
std::string PrepareUsualPagePath(const std::string& templateFile);

/// Writes the page. False, with the reason in words, when not every byte reached the file, or when the path
/// is that of the template itself, which is then left alone.
bool ExportHtmlDocumentation(const TemplateCore& core, const std::string& path, bool embedMathJax,
                             std::string& failure);

/// The page as text, created at the given local time.
std::string HtmlDocumentation(const TemplateCore& core, bool embedMathJax, const std::tm& created);

}  // namespace tessal
