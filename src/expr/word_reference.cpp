#include "expr/word_reference.h"

#include <algorithm>

namespace tessal {

namespace {

// Lengths and speeds are in the units of the engine's grid, times in the engine's own.
constexpr WordReference kProperties[] = {
    {"XPOS", "The place of the particle along the first axis.", "unknown"},
    {"YPOS", "The place of the particle along the second axis.", "unknown"},
    {"ZPOS", "The place of the particle along the vertical axis.", "unknown"},
    {"HITSTATE", "What the particle has hit, a bit for each; TESTHITSTATE looks at them.", "1"},
    {"AGE", "The age of the particle.", "unknown"},
    {"HDIR", "The direction in which the particle moves in the horizontal.", "unknown"},
    {"HSPEED", "The speed of the particle in the horizontal.", "unknown"},
    {"VSPEED", "The speed of the particle in the vertical.", "unknown"},
    {"PROJ_XPOS", "The place along the first axis to which the particle is projected.", "unknown"},
    {"PROJ_YPOS", "The place along the second axis to which the particle is projected.", "unknown"},
    {"PROJ_ZPOS", "The place along the vertical axis to which the particle is projected.", "unknown"},
    {"PROJ_HITSTATE", "What the particle is projected to hit, a bit for each.", "1"},
    {"ABOVE_GROUND", "How far the particle is above the ground.", "unknown"},
    {"BELOW_SURFACE", "How far the particle is below the surface of the water.", "unknown"},
    {"PREV_XPOS", "The place along the first axis where the particle was before.", "unknown"},
    {"PREV_YPOS", "The place along the second axis where the particle was before.", "unknown"},
    {"PREV_ZPOS", "The place along the vertical axis where the particle was before.", "unknown"},
    {"PREV_HITSTATE", "What the particle had hit before, a bit for each.", "1"},
    {"PARTICLEID", "The number of the particle.", "1"},
    {"SOURCEID", "The number of the source that the particle comes from.", "1"},
    {"PROJ_TIME", "The time over which places are projected; SET_PROJECTION changes it.", "s"},
    {"VIEWANGLE", "The angle within which the particle sees; SET_FOV changes it.", "degree"},
    {"ALIVE", "Whether the particle is alive.", "1"},
    {"ALL", "All that a particle carries, in an interaction.", "unknown"},
};

constexpr WordReference kVerbs[] = {
    {"CREATE", "Releases new particles.", ""},
    {"REMOVE", "Takes particles out of the model.", ""},
    {"KILL", "Lets particles die.", ""},
    {"TRANSFER", "Moves what particles carry from one to another.", ""},
    {"SPLIT", "Makes two particles of one.", ""},
    {"GETVALUE", "Reads a value of another particle.", ""},
};

}  // namespace

std::span<const WordReference> PropertyReferences() {
  return kProperties;
}

std::span<const WordReference> VerbReferences() {
  return kVerbs;
}

const WordReference* ReferenceOfWord(std::string_view word) {
  for (const std::span<const WordReference> rows : {PropertyReferences(), VerbReferences()}) {
    const auto hit =
        std::find_if(rows.begin(), rows.end(), [word](const WordReference& row) { return row.word == word; });
    if (hit != rows.end()) return &*hit;
  }
  return nullptr;
}

}  // namespace tessal
