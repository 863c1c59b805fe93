// A chapter of the guide as a page of HTML: for the help window of the editor, which knows only plain HTML,
// and for browsers.
#pragma once

#include <string>
#include <vector>

namespace tessal::guide {

struct Page {
  std::string title;  ///< the text of its first heading
  std::string body;   ///< what it says, with an anchor at each heading
};

/// Makes a page of a Markdown text. The file is its path in the project, such as "docs/guide/scopes.md":
/// links to other documents of the project become links between the published pages. Anchors of headings are
/// named as code hosts name them. Throws std::runtime_error when the text cannot be read as Markdown.
Page PageFromMarkdown(const std::string& markdown, const std::string& file);

/// The chapters that an index links to, by their file names without ending, in its order.
std::vector<std::string> ChaptersIn(const Page& index);

/// Where a document of the project is published, below the folder of shared files; empty when it is not.
std::string PublishedPath(const std::string& file);

}  // namespace tessal::guide
