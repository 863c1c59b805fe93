// Loading templates for a command, as the editor does.
#pragma once

#include <string>

namespace tessal {
class TemplateCore;
}

namespace tessal::cli {

/// Loads a file. False, with every message of the load on standard error, when it could not be loaded.
bool LoadOrComplain(TemplateCore& core, const std::string& file);

/// The same for a file that will be saved again: warns when a save would leave its further sections out.
bool LoadToSave(TemplateCore& core, const std::string& file);

/// Whether a new file may have this name. False, with the reason on standard error, when something has it.
bool IsFreeOrComplain(const std::string& output);

/// Saves a template. False, with the reasons on standard error, when it could not be saved.
bool SaveOrComplain(TemplateCore& core, const std::string& file);

}  // namespace tessal::cli
