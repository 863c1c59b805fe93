#include "elements/element_kind.h"

#include <array>
#include <cstddef>

namespace tessal {

namespace {

constexpr std::array<std::string_view, 35> kKindTexts = {
    "none",
    "State Variable",
    "Constant",
    "Forcing",
    "Auxiliary",
    "Process",
    "Derived Output",
    "Lagrange Specie",
    "Lagrange State Variable",
    "Lagrange Constant",
    "Lagrange_Forcing",
    "Search function",
    "Arithmetical Expression",
    "Horizontal Vector",
    "Downward Velocity",
    "Miscellaneous",
    "External User Function",
    "Visibility Defitions",
    "Visibility Group",
    "Visibility Groups",
    "unknown",
    "Tessal Setup",
    "State Variables",
    "Constants",
    "Forcing",
    "Auxiliaries",
    "Processes",
    "Derived Outputs",
    "State Variables",
    "Constants",
    "Forcing",
    "Restricted area search",
    "Arithmetic Expressions",
    "Horizontal Movement",
    "Downward Movement",
};

}  // namespace

std::string_view KindText(ElementKind kind) {
  const auto index = static_cast<std::size_t>(kind);
  return index < kKindTexts.size() ? kKindTexts[index] : KindText(ElementKind::Unknown);
}

}  // namespace tessal
