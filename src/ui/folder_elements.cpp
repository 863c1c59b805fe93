#include "ui/folder_elements.h"

#include <QStringList>

#include "core/template_core.h"
#include "ui/node_kinds.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

template <class Elements>
std::vector<const CEL_Element*> PointersTo(const Elements& elements) {
  std::vector<const CEL_Element*> pointers;
  pointers.reserve(elements.size());
  for (const auto& element : elements) pointers.push_back(element.get());
  return pointers;
}

}  // namespace

ElementKind KindInFolder(const CItemData& folder) {
  // The one downward movement of a class is never made.
  const bool isDownward = folder.kind == ElementKind::VerticalEquationList;
  return isDownward ? ElementKind::VerticalEquation : NodeRowOf(folder).creates;
}

std::vector<const CEL_Element*> ElementsOfFolder(const TemplateCore& core, const CItemData& folder) {
  std::vector<const CEL_Element*> elements;
  const ElementKind kind = KindInFolder(folder);
  const bool isOfTemplate = WithCollection(
      kind, [&elements, &core](const auto& row) { elements = PointersTo(core.Elements().*row.elements); });
  if (isOfTemplate) return elements;
  const CEL_Lagrange_Specie* specie = core.GetParentSpecie(folder.id);
  if (specie == nullptr) return elements;
  if (folder.kind == ElementKind::VerticalEquationList) return {specie->verticalEquation.get()};
  WithMemberList(kind,
                 [&elements, specie](const auto& list) { elements = PointersTo(specie->*list.members); });
  return elements;
}

QString SymbolsOf(const TemplateCore& core, const std::vector<Uid>& uids) {
  QStringList symbols;
  for (const Uid uid : uids) {
    if (const CEL_Element* element = core.GetElement(uid)) symbols.append(ToScreen(element->FullSymbol()));
  }
  return symbols.join(QStringLiteral(", "));
}

}  // namespace tessal
