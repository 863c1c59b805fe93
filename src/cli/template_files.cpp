#include "cli/template_files.h"

#include <algorithm>
#include <filesystem>
#include <memory>
#include <new>
#include <system_error>
#include <vector>

#include "cli/output.h"
#include "cli/template_paths.h"
#include "core/error_registry.h"
#include "core/template_core.h"
#include "elements/load_account.h"

namespace tessal::cli {

namespace {

void ComplainWithMessages(std::string_view what, const std::string& file) {
  if (RanOutOfMemory()) throw std::bad_alloc();
  std::string text;
  Complain(std::string(what) + " '" + file + "'");
  for (std::size_t index = 0; index < Errors().Records().size(); ++index) {
    Errors().FormatError(index, text);
    Complain(OnOneLine(WithoutLineFeed(text)));
  }
}

}  // namespace

TemplateCore& TheTemplate() {
  static TemplateCore& core = *std::make_unique<TemplateCore>().release();
  return core;
}

TemplateCore& AnotherTemplate() {
  using Templates = std::vector<std::unique_ptr<TemplateCore>>;
  static Templates& others = *std::make_unique<Templates>().release();
  return *others.emplace_back(std::make_unique<TemplateCore>());
}

bool RanOutOfMemory() {
  static constexpr Message kOutOfMemory("out-of-memory");
  const std::vector<ErrorRecord>& records = Errors().Records();
  return std::any_of(records.begin(), records.end(),
                     [](const ErrorRecord& record) { return record.code == kOutOfMemory->code; });
}

bool LoadOrComplain(TemplateCore& core, const std::string& file) {
  const bool loaded = LoadPath(core, file);
  if (!loaded) ComplainWithMessages("failed to load file", file);
  // From here on changes reach what depends on them, as in an editor.
  SetNotifyChanges(true);
  return loaded;
}

std::string AccountLine(const std::string& file, const AccountEntry& entry) {
  constexpr std::uint32_t kNotice = static_cast<std::uint32_t>(ErrorLevel::Notice);
  return OnOneLine(file) + ": " + Coloured(LevelWord(kNotice), kNotice) + ": " +
         (entry.symbol.empty() ? "generic" : OnOneLine(entry.symbol)) + ": " + OnOneLine(entry.text);
}

bool MayReplaceOrComplain(const TemplateCore& core, const std::string& file) {
  if (!core.Account().Loses()) return true;
  ComplainOfLosses(core, file);
  Complain("'" + file +
           "' holds what a save would lose; --force saves all the same, --output to another file");
  return false;
}

void ComplainOfLosses(const TemplateCore& core, const std::string& file) {
  for (const AccountEntry& entry : core.Account().Entries()) {
    if (entry.kind != AccountKind::Absent) Complain(AccountLine(file, entry));
  }
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
