#include "guide/chapter_page.h"

#include <md4c-html.h>

#include <algorithm>
#include <cctype>
#include <filesystem>
#include <stdexcept>
#include <string_view>

namespace tessal::guide {

namespace {

constexpr std::string_view kMarkdownEnding = ".md";
constexpr std::string_view kPageEnding = ".html";
constexpr std::string_view kLink = "<a href=\"";

struct Publication {
  std::string_view from;
  std::string_view to;
};

/// Documents whose page has another name.
constexpr Publication kPages[] = {{"docs/functions.md", "Functions.html"},
                                  {"docs/builtins.md", "Builtins.html"}};
/// Folders; the first that fits counts.
constexpr Publication kFolders[] = {{"docs/help/", ""}, {"docs/", ""}, {"examples/", "examples/"}};

/// What the help window does not know by itself: tables without lines are hard to read.
constexpr Publication kTags[] = {{"<table>", "<table border=\"1\" cellspacing=\"0\" cellpadding=\"4\">"}};

void Append(const MD_CHAR* text, MD_SIZE size, void* html) {
  static_cast<std::string*>(html)->append(text, size);
}

std::string HtmlOf(const std::string& markdown) {
  std::string html;
  const unsigned flags = MD_FLAG_TABLES | MD_FLAG_NOHTML;
  if (md_html(markdown.data(), static_cast<MD_SIZE>(markdown.size()), &Append, &html, flags, 0) != 0)
    throw std::runtime_error("cannot be read as Markdown");
  return html;
}

/// The text between tags, its entities as they are.
std::string WithoutTags(std::string_view html) {
  std::string text;
  bool isTag = false;
  for (const char character : html) {
    isTag = isTag || character == '<';
    if (!isTag) text += character;
    isTag = isTag && character != '>';
  }
  return text;
}

/// An entity is a sign, and signs are left out.
std::string WithoutEntities(std::string text) {
  for (std::size_t start = text.find('&'); start != std::string::npos; start = text.find('&', start))
    text.erase(start, text.find(';', start) + 1 - start);
  return text;
}

std::string AnchorOf(std::string_view heading) {
  std::string anchor;
  for (const char character : WithoutEntities(WithoutTags(heading))) {
    const auto byte = static_cast<unsigned char>(character);
    if (character == ' ') {
      anchor += '-';
    } else if (std::isalnum(byte) != 0 || character == '-' || character == '_' || byte >= 0x80) {
      anchor += static_cast<char>(std::tolower(byte));
    }
  }
  return anchor;
}

char ToUpper(char character) {
  return static_cast<char>(std::toupper(static_cast<unsigned char>(character)));
}

/// The target of a link, as seen from where the file is published.
std::string PublishedTarget(const std::string& target, const std::string& file) {
  const std::size_t fragment = std::min(target.find('#'), target.size());
  if (fragment == 0 || target.find("://") != std::string::npos) return target;
  const std::filesystem::path folder = std::filesystem::path(file).parent_path();
  const std::string linked = (folder / target.substr(0, fragment)).lexically_normal().generic_string();
  const std::string published = PublishedPath(linked);
  if (published.empty()) return target;
  const std::filesystem::path from = std::filesystem::path(PublishedPath(file)).parent_path();
  const std::string path =
      std::filesystem::path("/" + published).lexically_relative("/" + from.string()).generic_string();
  const bool isReference = std::any_of(std::begin(kPages), std::end(kPages),
                                       [&linked](const Publication& page) { return page.from == linked; });
  std::string anchor = target.substr(fragment);
  // The reference names its anchors as the catalogue does.
  if (isReference) std::transform(anchor.begin(), anchor.end(), anchor.begin(), ToUpper);
  return path + anchor;
}

/// Replaces the targets of all links.
std::string WithPublishedLinks(std::string html, const std::string& file) {
  for (std::size_t start = html.find(kLink); start != std::string::npos; start = html.find(kLink, start)) {
    start += kLink.size();
    const std::size_t size = html.find('"', start) - start;
    html.replace(start, size, PublishedTarget(html.substr(start, size), file));
  }
  return html;
}

/// The start of the next heading; its level is the character two places on.
std::size_t FindHeading(const std::string& html, std::size_t from) {
  constexpr std::string_view kLevels = "123456";
  for (std::size_t start = html.find("<h", from); start != std::string::npos;
       start = html.find("<h", start + 1)) {
    if (kLevels.find(html[start + 2]) != std::string_view::npos) return start;
  }
  return std::string::npos;
}

/// Gives each heading an anchor, and the page the first one's text as its title.
void MarkHeadings(Page& page) {
  constexpr std::size_t kTag = 4;
  for (std::size_t start = FindHeading(page.body, 0); start != std::string::npos;
       start = FindHeading(page.body, start)) {
    start += kTag;
    const std::string text = page.body.substr(start, page.body.find("</h", start) - start);
    if (page.title.empty()) page.title = WithoutTags(text);
    const std::string anchor = AnchorOf(text);
    std::string mark = "<a name=\"" + anchor;
    mark += "\" id=\"" + anchor;
    page.body.insert(start, mark + "\"></a>");
  }
}

void ReplaceTags(std::string& html) {
  for (const auto& [from, to] : kTags) {
    for (std::size_t start = html.find(from); start != std::string::npos;
         start = html.find(from, start + to.size()))
      html.replace(start, from.size(), to);
  }
}

}  // namespace

Page PageFromMarkdown(const std::string& markdown, const std::string& file) {
  Page page{"", WithPublishedLinks(HtmlOf(markdown), file)};
  MarkHeadings(page);
  ReplaceTags(page.body);
  return page;
}

std::vector<std::string> ChaptersIn(const Page& index) {
  std::vector<std::string> chapters;
  for (std::size_t start = index.body.find(kLink); start != std::string::npos;
       start = index.body.find(kLink, start)) {
    start += kLink.size();
    std::string target = index.body.substr(start, index.body.find('"', start) - start);
    if (!target.ends_with(kPageEnding) || target.find('/') != std::string::npos) continue;
    target.erase(target.size() - kPageEnding.size());
    if (std::find(chapters.begin(), chapters.end(), target) == chapters.end()) chapters.push_back(target);
  }
  return chapters;
}

std::string PublishedPath(const std::string& file) {
  for (const auto& [from, to] : kPages) {
    if (file == from) return std::string(to);
  }
  for (const auto& [from, to] : kFolders) {
    if (!file.starts_with(from)) continue;
    std::string path = std::string(to) + file.substr(from.size());
    if (path.ends_with(kMarkdownEnding))
      path.replace(path.size() - kMarkdownEnding.size(), kMarkdownEnding.size(), kPageEnding);
    return path;
  }
  return {};
}

}  // namespace tessal::guide
