// What a public template holds: the core's template, and its elements by their identities.
#pragma once

#include <unordered_map>
#include <vector>

#include "core/template_core.h"
#include "tessal/element.h"
#include "tessal/template.h"

namespace tessal {
inline namespace v1 {

class TemplateData final {
 public:
  TemplateData();

  /// The core, with its symbol table up to date.
  TemplateCore& Core();

  /// The element with a record that has this identity; none once it is removed.
  CEL_Element* Find(Uid uid);
  /// The same for a handle; none for one of another template, as no two elements of a process have one
  /// identity.
  CEL_Element* Find(const Element& element);
  Element HandleOf(const CEL_Element& element) { return {*this, NumberOf(element.GetUid())}; }

  /// A value has changed. The symbol table follows at the next question: one rebuild for any number of
  /// values.
  void MarkStale() { isStale = true; }
  /// Elements may come or go.
  void ForgetIndex() { index.clear(); }

  std::vector<TemplateMessage> loadMessages;

 private:
  TemplateCore core;
  bool isStale = false;
  std::unordered_map<Uid, CEL_Element*> index;
};

/// Of a template that was not moved from. A question may bring the symbol table up to date, so it is not
/// const.
TemplateData& DataOf(const Template& model);

}  // namespace v1
}  // namespace tessal
