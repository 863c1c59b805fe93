// The merge of templates, for people and as a driver of version control.
#include "cli/commands.h"
#include "cli/template_files.h"
#include "core/merge.h"
#include "core/template_core.h"
#include "elements/load_account.h"

namespace tessal::cli {

namespace {

std::string Quoted(const std::string& value) {
  return "'" + OnOneLine(value) + "'";
}

std::string ConflictLine(const MergeConflict& conflict) {
  std::string line = "conflict: " + conflict.kind;
  if (!conflict.symbol.empty()) line += " " + OnOneLine(conflict.symbol);
  if (!conflict.field.empty()) line += " " + conflict.field;
  return line + ": ours " + Quoted(conflict.ours) + ", theirs " + Quoted(conflict.theirs);
}

}  // namespace

ExitCode RunMerge(const MergeCall& call) {
  TemplateCore& ours = TheTemplate();
  TemplateCore& base = AnotherTemplate();
  TemplateCore& theirs = AnotherTemplate();
  if (!call.output.empty() && !call.force && !IsFreeOrComplain(call.output)) return kCallFault;
  if (!LoadOrComplain(base, call.base) || !LoadOrComplain(theirs, call.theirs) ||
      !LoadOrComplain(ours, call.ours))
    return kCallFault;
  if (!call.output.empty()) {
    ComplainOfLosses(ours, call.ours);
  } else if (!call.force && !MayReplaceOrComplain(ours, call.ours)) {
    return kContentFault;
  }
  ComplainOfLosses(theirs, call.theirs);
  const std::vector<MergeConflict> conflicts = ours.Merge(base, theirs);
  if (!SaveOrComplain(ours, call.output.empty() ? call.ours : call.output)) return kCallFault;
  for (const MergeConflict& conflict : conflicts) Complain(ConflictLine(conflict));
  return conflicts.empty() && !theirs.Account().Loses() ? kFine : kContentFault;
}

}  // namespace tessal::cli
