#include "core/replace.h"

#include <algorithm>
#include <utility>

#include "core/rebuild_off.h"
#include "core/template_core.h"
#include "core/text_pattern.h"

namespace tessal {

namespace {

ReplaceObstacle ObstacleOf(const FoundText& found) {
  if (found.role == TextRole::Symbol) return ReplaceObstacle::Symbol;
  return found.isLocked ? ReplaceObstacle::Locked : ReplaceObstacle::None;
}

/// Makes one change; why not, or an empty text.
std::string Apply(TextsByPlace& texts, const Replacement& replacement, TextEncoding encoding) {
  const TextPlace& place = replacement.found.place;
  const CEL_Property* property = texts.PropertyAt(place);
  if (ToUtf8(texts.TextAt(place)) != replacement.found.text) return "The text has changed since the preview.";
  if (replacement.obstacle != ReplaceObstacle::None || (property != nullptr && !property->Editable()))
    return "The text is locked.";
  const std::string after = EncodedText(replacement.after, encoding);
  if (!texts.SetText(place, after)) return "The name is empty, or another has it.";
  return texts.TextAt(place) == after ? std::string() : "The element did not take the text.";
}

}  // namespace

ReplacePreview PreviewReplacements(const TemplateCore& core, const FindQuery& query,
                                   const std::string& replacement) {
  ReplacePreview preview;
  FindResult result = FindTexts(core, query);
  const TextPattern pattern(query.pattern);
  preview.failure = result.failure.empty() ? pattern.ReplacementFailure(replacement) : result.failure;
  if (!preview.failure.empty()) return preview;
  for (FoundText& found : result.found) {
    const ReplaceObstacle obstacle = ObstacleOf(found);
    const bool isFree = obstacle == ReplaceObstacle::None;
    std::string after = isFree ? pattern.Replaced(found.text, replacement) : found.text;
    if (isFree && after == found.text) continue;
    preview.replacements.push_back({std::move(found), std::move(after), obstacle, isFree});
  }
  return preview;
}

ReplaceOutcome ApplyReplacements(TemplateCore& core, std::span<const Replacement> replacements,
                                 TextEncoding encoding) {
  ReplaceOutcome outcome;
  const EditStep step(core.History(), "Replace in texts and expressions");
  {
    const RebuildOff oneAtTheEnd(core);
    TextsByPlace texts(core);
    for (std::size_t place = 0; place < replacements.size(); ++place) {
      if (!replacements[place].isChosen) continue;
      std::string reason = Apply(texts, replacements[place], encoding);
      if (reason.empty()) {
        ++outcome.applied;
      } else {
        outcome.refused.push_back({place, std::move(reason)});
      }
    }
  }
  if (outcome.applied > 0) core.RebuildSymbolTable();
  return outcome;
}

}  // namespace tessal
