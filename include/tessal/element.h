// One element of a template: a state variable, a constant, a process, a particle class or a member of one.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "tessal/export.h"
#include "tessal/message.h"

namespace tessal {
inline namespace v1 {

/// What an element is. The numbers are those that `tessal symbols` prints.
enum class Kind : int {
  None = 0,
  StateVariable = 1,
  Constant = 2,
  Forcing = 3,
  Auxiliary = 4,
  Process = 5,
  DerivedOutput = 6,
  ParticleClass = 7,
  // Members of a particle class.
  ParticleStateVariable = 8,
  ParticleConstant = 9,
  ParticleForcing = 10,
  AreaSearch = 11,
  ArithmeticExpression = 12,
  HorizontalMovement = 13,
  VerticalMovement = 14
};

/// A named value of an element. The expression of a state variable is its "Equation".
struct Field {
  std::string label{};                 ///< "Unit", "Expression": the editor shows the same
  std::string value{};                 ///< numbers in decimal, truths as "YES" or "NO"
  bool isEditable = true;              ///< false where another value of the element fixes it
  std::vector<std::string> choices{};  ///< the values that it may have; none where any is fine
};

class TemplateData;

/// A handle: small, copied freely, good as long as its template. Once the element is removed, questions give
/// empty answers and changes are refused; it is there again when the removal is taken back.
class TESSAL_API Element final {
 public:
  bool Exists() const;
  /// A movement's has the class in it, as messages have it.
  std::string Symbol() const;
  Kind GetKind() const;
  /// The symbol of the particle class that it is a member of; empty for the template's own elements.
  std::string ClassSymbol() const;

  std::vector<Field> Fields() const;
  /// The value of the field with a label; nothing when the element has no such field.
  std::optional<std::string> Get(std::string_view label) const;
  /// Gives a field another value, as one step that can be taken back. Refused for a field that there is not
  /// or that is locked, for a value that it may not have, and for symbols, which `Template::Rename` changes.
  Outcome Set(std::string_view label, std::string_view value);

  /// The elements that its expressions use, in the order of first use, and those that use it, in the order of
  /// the template; each once.
  std::vector<Element> Uses() const;
  std::vector<Element> UsedBy() const;

  friend bool operator==(const Element&, const Element&) = default;

 private:
  friend class TemplateData;
  Element(TemplateData& ofTemplate, std::int32_t itsUid) : data(&ofTemplate), uid(itsUid) {}

  TemplateData* data;
  std::int32_t uid;
};

}  // namespace v1
}  // namespace tessal
