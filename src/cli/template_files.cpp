#include "cli/template_files.h"

#include <filesystem>
#include <system_error>

#include "cli/output.h"
#include "core/error_registry.h"
#include "core/template_core.h"

namespace tessal::cli {

namespace {

void ComplainWithMessages(std::string_view what, const std::string& file) {
  std::string text;
  Complain(std::string(what) + " '" + file + "'");
  for (std::size_t index = 0; index < Errors().Records().size(); ++index) {
    Errors().FormatError(index, text);
    Complain(OnOneLine(WithoutLineFeed(text)));
  }
}

}  // namespace

bool LoadOrComplain(TemplateCore& core, const std::string& file) {
  const bool loaded = core.LoadWrapper(file);
  if (!loaded) ComplainWithMessages("failed to load file", file);
  // From here on changes reach what depends on them, as in an editor.
  SetNotifyChanges(true);
  return loaded;
}

bool LoadToSave(TemplateCore& core, const std::string& file) {
  if (!LoadOrComplain(core, file)) return false;
  for (const ErrorRecord& record : Errors().Records()) {
    if (record.symbol != kNotKeptSymbol) continue;
    Complain("'" + file + "': sections beside TESSAL_SETUP, if there are any, are not kept: " +
             std::string(WithoutLineFeed(record.text)));
  }
  return true;
}

bool IsFreeOrComplain(const std::string& output) {
  std::error_code shownByTheSave;
  if (!std::filesystem::exists(std::filesystem::symlink_status(output, shownByTheSave))) return true;
  Complain("'" + output + "' exists already; --force replaces it");
  return false;
}

bool SaveOrComplain(TemplateCore& core, const std::string& file) {
  // What the load found is no part of why a save fails.
  Errors().ClearErrors();
  if (core.SaveWrapper(file)) return true;
  ComplainWithMessages("failed to save file", file);
  return false;
}

}  // namespace tessal::cli
