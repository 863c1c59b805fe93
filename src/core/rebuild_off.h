// Many changes with one rebuild of the symbol table after them, in the place of one for each.
#pragma once

#include "core/template_core.h"

namespace tessal {

/// No change rebuilds the table for its lifetime. The caller rebuilds afterwards.
class RebuildOff final {
 public:
  explicit RebuildOff(TemplateCore& changed) : core(changed) { core.SetRebuildEnabled(false); }
  RebuildOff(const RebuildOff&) = delete;
  RebuildOff& operator=(const RebuildOff&) = delete;
  ~RebuildOff() { core.SetRebuildEnabled(true); }

 private:
  TemplateCore& core;
};

}  // namespace tessal
