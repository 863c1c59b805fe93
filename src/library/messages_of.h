// The messages of the library's inside as those of its surface.
#pragma once

#include <span>
#include <string>
#include <vector>

#include "tessal/message.h"

namespace tessal {

struct AnalysisFinding;
class LoadAccount;

/// What the list of the process holds now. Raises `std::bad_alloc` when it says that there was no memory.
std::vector<TemplateMessage> RegistryMessages();

/// What a save would lose.
std::vector<TemplateMessage> LossesOf(const LoadAccount& account);

std::vector<TemplateMessage> MessagesOf(std::span<const AnalysisFinding> findings);

/// The texts, a line each, as a reason.
std::string JoinedTexts(const std::vector<TemplateMessage>& messages);

}  // namespace tessal
