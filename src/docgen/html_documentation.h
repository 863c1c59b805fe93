// One HTML page that documents a whole template, with every expression as a MathML block.
#pragma once

#include <ctime>
#include <optional>
#include <string>
#include <string_view>

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

/// How a page is written.
struct PageOptions {
  /// The address of the MathJax script that renders the equations; none for an empty one.
  std::string mathJax;
  /// Whether texts of the template are written so that no markup in them takes effect, and anchors so that
  /// every link leads to its element. Otherwise both are written as they are.
  bool isSafe = false;
};

/// The address of the MathJax script that pages embed when nobody gives another.
std::string_view UsualMathJax();

/// Writes the page. False, with the reason in words, when not every byte reached the file, or when the path
/// is that of the template itself, which is then left alone.
bool ExportHtmlDocumentation(const TemplateCore& core, const std::string& path, const PageOptions& options,
                             std::string& failure);

/// The page as text, created at the given local time. A page in UTF-8 with more than ASCII begins with a byte
/// order mark, which browsers believe before what a server says.
std::string HtmlDocumentation(const TemplateCore& core, const PageOptions& options, const std::tm& created);
/// The same, created now.
std::string HtmlDocumentation(const TemplateCore& core, const PageOptions& options);

}  // namespace tessal
