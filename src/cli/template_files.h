// Loading templates for a command, as the editor does.
#pragma once

#include <string>

namespace tessal {
class TemplateCore;
struct AccountEntry;
}  // namespace tessal

namespace tessal::cli {

/// The template that a command works on. Nobody takes it apart: the process ends with it.
TemplateCore& TheTemplate();

/// A further one, which goes with the process too.
TemplateCore& AnotherTemplate();

/// Whether the last load or save ended for want of memory, which is no fault of the file.
bool RanOutOfMemory();

/// Loads a file. False, with every message of the load on standard error, when it could not be loaded. Raises
/// `std::bad_alloc` when there was no memory for it; so does a save.
bool LoadOrComplain(TemplateCore& core, const std::string& file);

/// An entry of a load's account as `check` lists it.
std::string AccountLine(const std::string& file, const AccountEntry& entry);

/// Lists on standard error what a save of the loaded file would lose.
void ComplainOfLosses(const TemplateCore& core, const std::string& file);

/// Whether the file may be replaced by the template that was loaded from it: not, with what would be lost on
/// standard error, when the load did not take over all of it.
bool MayReplaceOrComplain(const TemplateCore& core, const std::string& file);

/// Whether a new file may have this name. False, with the reason on standard error, when something has it.
bool IsFreeOrComplain(const std::string& output);

/// Saves a template. False, with the reasons on standard error, when it could not be saved.
bool SaveOrComplain(TemplateCore& core, const std::string& file);

}  // namespace tessal::cli
