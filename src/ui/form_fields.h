// The fields that the tables of several forms share.
#pragma once

#include "ui/control_ids.h"
#include "ui/element_form.h"
#include "ui/property_of.h"

namespace tessal {

inline constexpr FormField kSymbol{control_id::kSymbol, "Symbol", FieldEditor::Symbol,
                                   Of<&CEL_Element::symbol>};
inline constexpr FormField kDescription{control_id::kDescription, "Description", FieldEditor::Lines,
                                        Of<&CEL_Element::description>};
inline constexpr FormField kOnlineHelp{control_id::kOnlineHelp, "Online help", FieldEditor::Line,
                                       Of<&CEL_Element::onlineHelp>};
inline constexpr FormField kDocumentation{control_id::kDocumentation, "Documentation",
                                          FieldEditor::Documentation, Of<&CEL_Element::documentation>};
inline constexpr FormField kReferencedIn{control_id::kReferencedIn, "Referenced in",
                                         FieldEditor::ReferencedIn, nullptr};
inline constexpr FormField kUnitType{1045, "Unq type", FieldEditor::SortedChoice, Of<&CEL_Element::unqType>};

inline constexpr int kScopeControl = 1055;
inline constexpr int kSpatialControl = 1056;
inline constexpr int kExpressionControl = 1115;

}  // namespace tessal
