// One HTML page that documents a whole template, with every expression as a MathML block.
#pragma once

#include <ctime>
#include <string>
#include <string_view>

namespace tessal {

class TemplateCore;

/// Where the page of a template file goes when nobody names a place: the folder `HTML_doc` beside the file,
/// and in it the file's plain name.
std::string UsualPagePath(const std::string& templateFile);

/// The same, with the folder made; one that cannot be made shows when the page is written.
std::string PrepareUsualPagePath(const std::string& templateFile);

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

}  // namespace tessal
