// The generated model as a template, and files of it.
#pragma once

#include <cstdint>
#include <string>

#include "scratch_folder.h"

namespace tessal::bench {

struct GeneratedModel;

/// The text of a template file of the model.
std::string TemplateText(const GeneratedModel& model);

/// Writes the template of a model of about that many elements and returns its path.
std::string FileOfSize(const ScratchFolder& folder, std::int64_t elements);

/// The same of a template that has constants alone.
std::string FileOfConstants(const ScratchFolder& folder, int count);

}  // namespace tessal::bench
