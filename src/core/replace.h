// Replacing what a search finds: first a preview, a list of changes that can be switched off one by one, then
// the changes as one act.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <vector>

#include "core/find.h"
#include "platform/text_encoding.h"

namespace tessal {

/// Why a text is found and not replaced.
enum class ReplaceObstacle : std::uint8_t {
  None,
  Symbol,  ///< a rename takes its uses along
  Locked   ///< a built-in or a unit type fixes the text
};

/// One change: a text with all its matches replaced.
struct Replacement {
  FoundText found;
  std::string after;  ///< in UTF-8; the text itself where there is an obstacle
  ReplaceObstacle obstacle = ReplaceObstacle::None;
  bool isChosen = true;  ///< the user's choice; false from the start where there is an obstacle
};

struct ReplacePreview {
  std::vector<Replacement> replacements;
  std::string failure;  ///< why the pattern or the replacement cannot be used; empty when both can
};

/// What a replacement would change. Texts that would stay the same are left out.
ReplacePreview PreviewReplacements(const TemplateCore& core, const FindQuery& query,
                                   const std::string& replacement);

struct RefusedReplacement {
  std::size_t place;  ///< in the list that was applied
  std::string reason;
};

struct ReplaceOutcome {
  std::size_t applied = 0;
  std::vector<RefusedReplacement> refused;
};

/// Makes the chosen changes, in their order, with one rebuild of the symbol table after the last. One whose
/// text is not that of the preview any more is refused, with a reason for the user, and so is one that its
/// owner does not take.
ReplaceOutcome ApplyReplacements(TemplateCore& core, std::span<const Replacement> replacements,
                                 TextEncoding encoding);

}  // namespace tessal
