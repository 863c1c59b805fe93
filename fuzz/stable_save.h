// What holds of every template that was saved, for fuzz targets: it comes back from its file, and stays.
#pragma once

#include <string>
#include <string_view>

#include "core/template_core.h"
#include "expr/scanner.h"
#include "support/template_content.h"
#include "template_file.h"

namespace tessal::fuzz {

inline std::string Content(const std::string& path) {
  std::string failure;
  const auto text = ReadWholeFile(path, failure);
  Require(text.has_value(), "a file that was saved can be read");
  return *text;
}

/// Without the rest of each line that has the keyword: texts may hold it too.
inline std::string WithoutRevision(std::string text) {
  constexpr std::string_view kKey = "DOCUMENT_REVISION";
  for (std::size_t place = text.find(kKey); place != std::string::npos; place = text.find(kKey, place)) {
    text.erase(place, text.find('\n', place) - place);
  }
  return text;
}

/// A second load of the file that a template was saved to gives the same template, with nothing that a save
/// would lose; a second save gives the same file, but for the revision.
inline void RequireStable(TemplateCore& core, const std::string& path) {
  const std::string once = Content(path);
  const std::string content = test::TemplateContent(core);
  ResetExpressionScanner();
  TemplateCore again;
  Require(again.LoadWrapper(path), "what was saved loads");
  for (const AccountEntry& entry : again.Account().Entries()) {
    if (entry.kind != AccountKind::Absent) std::fprintf(stderr, "%s\n", entry.text.c_str());
  }
  Require(!again.Account().Loses(), "and has nothing to lose");
  const std::string loaded = test::TemplateContent(again);
  if (loaded != content) std::fprintf(stderr, "%s\n-- becomes --\n%s\n", content.c_str(), loaded.c_str());
  Require(loaded == content, "it holds the same values");
  Require(again.KeptText() == core.KeptText(), "and the same text beside the template");
  Require(again.SaveWrapper(path), "it is saved again");
  Require(WithoutRevision(Content(path)) == WithoutRevision(once), "and stays the same");
}

}  // namespace tessal::fuzz
