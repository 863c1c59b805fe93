// One HTML page that documents a whole template, with every expression as a MathML block.
#pragma once

#include <ctime>
#include <optional>
#include <string>

namespace tessal {

class TemplateCore;

/// Where the page of a template file goes when nobody names a place: the folder `HTML_doc` beside the file,
/// and in it the file's plain name.
std::string UsualPagePath(const std::string& templateFile);

/// The same, with the folder made. Nothing, with the reason in words, when what lies there is not for us to
/// replace: others may have made the folder, so a link in the place of the folder or of the page, and a file
/// that is no page of ours, are left alone. A folder that cannot be made shows when the page is written.
std::optional<std::string> PrepareUsualPagePath(const std::string& templateFile, std::string& failure);

/// Why a page may not take the place of what has this path, or the empty text: what is there is neither an
/// older page nor an empty file.
std::string PageRefusal(const std::string& path);

/// Writes the page. False, with the reason in words, when not every byte reached the file, or when the path
/// is that of the template itself, which is then left alone.
bool ExportHtmlDocumentation(const TemplateCore& core, const std::string& path, bool embedMathJax,
                             std::string& failure);

/// The page as text, created at the given local time.
std::string HtmlDocumentation(const TemplateCore& core, bool embedMathJax, const std::tm& created);

}  // namespace tessal
