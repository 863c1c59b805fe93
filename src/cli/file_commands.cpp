// Commands that write a template: save, repair, new and rename.
#include "cli/commands.h"
#include "cli/template_files.h"
#include "core/rename.h"
#include "core/template_core.h"
#include "elements/load_account.h"
#include "elements/property_io.h"

namespace tessal::cli {

namespace {

/// Whether the output of a call, if it names one, may be written.
template <class Call>
bool MayWriteOutput(const Call& call) {
  return call.output.empty() || call.force || IsFreeOrComplain(call.output);
}

/// Whether the file may be replaced, or an output written that lacks what the load did not take over.
template <class Call>
bool MayLose(const TemplateCore& core, const Call& call) {
  if (call.output.empty()) return call.force || MayReplaceOrComplain(core, call.file);
  ComplainOfLosses(core, call.file);
  return true;
}

}  // namespace

ExitCode RunSave(const SaveCall& call) {
  TemplateCore& core = TheTemplate();
  if (!MayWriteOutput(call) || !LoadOrComplain(core, call.file)) return kCallFault;
  if (!MayLose(core, call)) return kContentFault;
  return SaveOrComplain(core, call.output.empty() ? call.file : call.output) ? kFine : kCallFault;
}

ExitCode RunRepair(const SaveCall& call) {
  TemplateCore& core = TheTemplate();
  if (!MayWriteOutput(call) || !LoadOrComplain(core, call.file)) return kCallFault;
  for (const AccountEntry& entry : core.Account().Entries()) PrintLine(AccountLine(call.file, entry));
  const bool isWhole = core.TakeOverPassedOver();
  if (!SaveOrComplain(core, call.output.empty() ? call.file : call.output)) return kCallFault;
  return isWhole ? kFine : kContentFault;
}

ExitCode RunNew(const std::string& output, bool overwrite) {
  if (!overwrite && !IsFreeOrComplain(output)) return kCallFault;
  TemplateCore& core = TheTemplate();
  return SaveOrComplain(core, output) ? kFine : kCallFault;
}

namespace {

Rewriting RewritingOf(const RenameCall& call) {
  if (call.onlySymbol) return Rewriting::None;
  return call.wholeWords ? Rewriting::WholeNames : Rewriting::ByLetters;
}

/// Lists what a rename by letters would lose, unless it loses nothing, or was asked for.
bool ComplainOfLostNames(const TemplateCore& core, const RenameCall& call, const std::string& newSymbol) {
  if (RewritingOf(call) != Rewriting::ByLetters || call.letterRule) return false;
  const std::vector<LostName> lost = LostByRename(core, call.oldSymbol, newSymbol);
  if (lost.empty()) return false;
  Complain("longer names would change too (" + std::to_string(lost.size()) + "):");
  for (const LostName& name : lost) Complain(LossText(core, name));
  Complain("--whole-words leaves them alone, --letter-rule changes them");
  return true;
}

}  // namespace

ExitCode RunRename(const RenameCall& call) {
  TemplateCore& core = TheTemplate();
  if (!MayWriteOutput(call) || !LoadOrComplain(core, call.file)) return kCallFault;
  if (!MayLose(core, call)) return kContentFault;
  const std::string newSymbol(CleanText(call.newSymbol));
  std::string refusal = RenameRefusal(core, newSymbol);
  if (refusal.empty() && ComplainOfLostNames(core, call, newSymbol)) return kContentFault;
  if (refusal.empty() && !core.Rename(call.oldSymbol, newSymbol, RewritingOf(call))) {
    refusal = RenameFailure(newSymbol);
  }
  if (!refusal.empty()) {
    PrintLine(refusal);
    return kContentFault;
  }
  return SaveOrComplain(core, call.output.empty() ? call.file : call.output) ? kFine : kCallFault;
}

}  // namespace tessal::cli
