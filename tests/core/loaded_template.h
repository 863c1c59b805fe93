// A template loaded from text, for tests.
#pragma once

#include <string>

#include "core/template_core.h"
#include "support/temporary_folder.h"

namespace tessal::test {

/// Loads the text from a file of its own folder. Notifications are on afterwards, as in an editor.
class LoadedTemplate final {
 public:
  explicit LoadedTemplate(const std::string& text);
  LoadedTemplate(const LoadedTemplate&) = delete;
  LoadedTemplate& operator=(const LoadedTemplate&) = delete;
  ~LoadedTemplate();

  TemplateCore& operator*() { return core; }
  TemplateCore* operator->() { return &core; }
  bool Loaded() const { return loaded; }
  const std::string& Path() const { return path; }
  std::string Undefined() const;

 private:
  TemporaryFolder folder;
  std::string path;
  TemplateCore core;
  bool loaded;
};

/// The registry's messages, one a line: level, symbol, text, and line of the file where there is one.
std::string Messages();

}  // namespace tessal::test
