// Makes the pages of the guide, at build time:
//
//     guide_pages PROJECT OUTPUT DOCUMENT...
//
// reads PROJECT/docs/guide/index.md and the chapters that it links to, and the further documents (such as
// docs/analysis.md), and writes their pages below OUTPUT, where the help pages lie.
#include <cstdio>
#include <exception>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <string>
#include <vector>

#include "guide/chapter_page.h"
#include "guide/guide_style.h"

namespace tessal::guide {
namespace {

namespace fs = std::filesystem;

const std::string kFolder = "docs/guide/";
const std::string kIndex = "index";

std::string ChapterFile(const std::string& chapter) {
  return kFolder + chapter + ".md";
}

Page ReadPage(const fs::path& project, const std::string& file) {
  std::ifstream stream(project / file, std::ios::binary);
  const std::string text{std::istreambuf_iterator<char>(stream), {}};
  if (!stream || text.empty()) throw std::runtime_error(file + " cannot be read, or is empty");
  return PageFromMarkdown(text, file);
}

std::string Link(const std::string& target, const std::string& text) {
  return "<a href=\"" + target + "\">" + text + "</a>";
}

void WritePage(const fs::path& output, const std::string& file, const Page& page, const std::string& way) {
  const fs::path path = output / PublishedPath(file);
  fs::create_directories(path.parent_path());
  std::ofstream stream(path, std::ios::binary);
  stream << "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n<title>" << page.title
         << "</title>\n"
         << kGuideStyle << "\n</head>\n<body>\n"
         << way << page.body << "<hr>\n"
         << way << "</body>\n</html>\n";
  stream.close();
  if (!stream) throw std::runtime_error(path.string() + " cannot be written");
}

/// The line of links over and under a page.
std::string Way(const std::vector<std::string>& links) {
  std::string way = "<p class=\"way\">";
  for (const std::string& link : links) way += (&link == &links.front() ? "" : " &middot; ") + link;
  return way + "</p>\n";
}

/// A chapter, with links to the one before it and the one after it.
void WriteChapters(const fs::path& project, const fs::path& output) {
  const Page index = ReadPage(project, ChapterFile(kIndex));
  const std::string help = Link("../TessalOnline.html", "Help on each page");
  WritePage(output, ChapterFile(kIndex), index, Way({help}));
  const std::vector<std::string> chapters = ChaptersIn(index);
  std::vector<Page> pages;
  pages.reserve(chapters.size());
  for (const std::string& chapter : chapters) pages.push_back(ReadPage(project, ChapterFile(chapter)));
  for (std::size_t place = 0; place < chapters.size(); ++place) {
    std::vector<std::string> links{Link("index.html", index.title)};
    const auto addLink = [&](const std::string& caption, std::size_t other) {
      if (other < chapters.size())
        links.push_back(caption + Link(chapters[other] + ".html", pages[other].title));
    };
    addLink("Before: ", place - 1);
    addLink("Next: ", place + 1);
    links.push_back(help);
    WritePage(output, ChapterFile(chapters[place]), pages[place], Way(links));
  }
}

void WriteAll(const fs::path& project, const fs::path& output, const std::vector<std::string>& documents) {
  WriteChapters(project, output);
  const std::string way =
      Way({Link("guide/index.html", "The guide"), Link("TessalOnline.html", "Help on each page")});
  for (const std::string& file : documents) WritePage(output, file, ReadPage(project, file), way);
}

}  // namespace
}  // namespace tessal::guide

int main(int count, char** arguments) {
  const std::vector<std::string> given(arguments + 1, arguments + count);
  if (given.size() < 2) {
    std::fputs("usage: guide_pages PROJECT OUTPUT DOCUMENT...\n", stderr);
    return 2;
  }
  try {
    tessal::guide::WriteAll(given[0], given[1], {given.begin() + 2, given.end()});
  } catch (const std::exception& failure) {
    std::fprintf(stderr, "guide_pages: %s\n", failure.what());
    return 1;
  }
  return 0;
}
