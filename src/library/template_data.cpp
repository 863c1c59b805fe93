#include "library/template_data.h"

#include "elements/property.h"

namespace tessal {
inline namespace v1 {

TemplateData::TemplateData() {
  core.SetModified(false);
  core.History().Start();
}

TemplateCore& TemplateData::Core() {
  // The load of any template leaves them off.
  SetNotifyChanges(true);
  if (isStale) {
    isStale = false;
    core.RebuildSymbolTable();
  }
  return core;
}

CEL_Element* TemplateData::Find(Uid uid) {
  const TemplateCore& fresh = Core();
  if (index.empty()) {
    for (const SymbolRecord& record : fresh.SymbolTable()) index.try_emplace(record.uid, record.element);
  }
  const auto hit = index.find(uid);
  return hit == index.end() ? nullptr : hit->second;
}

CEL_Element* TemplateData::Find(const Element& element) {
  return Find(Uid{element.uid});
}

TemplateData& DataOf(const Template& model) {
  return *model.data;
}

}  // namespace v1
}  // namespace tessal
