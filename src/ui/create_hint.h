// The argument of the hint that asks the main view to create an element.
#pragma once

#include <cstdint>
#include <string>
#include <utility>

#include "core/creation.h"
#include "platform/docview.h"

namespace tessal {

struct CreateHint final : UpdateHint {
  explicit CreateHint(CreateRequest what) : request(std::move(what)) {}
  CreateRequest request;
};

/// The argument of the hint that gives a visibility group's node another caption.
struct RenameGroupHint final : UpdateHint {
  RenameGroupHint(std::int32_t groupPosition, std::string newName)
      : position(groupPosition), name(std::move(newName)) {}
  std::int32_t position;
  std::string name;
};

}  // namespace tessal
