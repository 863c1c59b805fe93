#include "a11y/accessible.h"

#include <algorithm>
#include <chrono>
#include <thread>

namespace tessal::test {

namespace {

/// More than any form has, and enough of the cells of a list.
constexpr int kMostChildren = 50;

/// Drops the reason of a question without answer.
class Failure final {
 public:
  Failure() = default;
  Failure(const Failure&) = delete;
  Failure& operator=(const Failure&) = delete;
  ~Failure() { g_clear_error(&error); }
  GError** Place() {
    g_clear_error(&error);
    return &error;
  }

 private:
  GError* error = nullptr;
};

struct Unref {
  void operator()(gpointer object) const { g_object_unref(object); }
};
template <typename T>
using Owned = std::unique_ptr<T, Unref>;

std::string Taken(gchar* text) {
  std::string copy(text == nullptr ? "" : text);
  g_free(text);
  return copy;
}

std::string NameOf(AtspiRole role) {
  return Taken(atspi_role_get_name(role));
}

}  // namespace

std::string Accessible::Name() const {
  Failure failure;
  return Taken(atspi_accessible_get_name(object.get(), failure.Place()));
}

std::string Accessible::Description() const {
  Failure failure;
  return Taken(atspi_accessible_get_description(object.get(), failure.Place()));
}

AtspiRole Accessible::Role() const {
  Failure failure;
  return atspi_accessible_get_role(object.get(), failure.Place());
}

bool Accessible::Is(AtspiStateType state) const {
  return (States() >> static_cast<unsigned>(state) & 1U) != 0;
}

std::uint64_t Accessible::States() const {
  if (object == nullptr) return 0;
  const Owned<AtspiStateSet> states(atspi_accessible_get_state_set(object.get()));
  return states == nullptr ? 0 : static_cast<std::uint64_t>(states->states);
}

int Accessible::ProcessId() const {
  Failure failure;
  return static_cast<int>(atspi_accessible_get_process_id(object.get(), failure.Place()));
}

std::vector<std::string> Accessible::Labels() const {
  Failure failure;
  std::vector<std::string> texts;
  GArray* relations = atspi_accessible_get_relation_set(object.get(), failure.Place());
  if (relations == nullptr) return texts;
  for (guint place = 0; place < relations->len; ++place) {
    const Owned<AtspiRelation> relation(g_array_index(relations, AtspiRelation*, place));
    if (atspi_relation_get_relation_type(relation.get()) != ATSPI_RELATION_LABELLED_BY) continue;
    for (int target = 0; target < atspi_relation_get_n_targets(relation.get()); ++target)
      texts.push_back(Accessible(atspi_relation_get_target(relation.get(), target)).Name());
  }
  g_array_free(relations, TRUE);
  return texts;
}

std::vector<Accessible> Accessible::Children(int most) const {
  Failure failure;
  std::vector<Accessible> children;
  const int count = std::min(most, atspi_accessible_get_child_count(object.get(), failure.Place()));
  for (int place = 0; place < count; ++place) {
    Accessible child(atspi_accessible_get_child_at_index(object.get(), place, failure.Place()));
    if (child) children.push_back(std::move(child));
  }
  return children;
}

std::string Accessible::Text() const {
  Failure failure;
  const Owned<AtspiText> text(atspi_accessible_get_text_iface(object.get()));
  return text == nullptr ? std::string() : Taken(atspi_text_get_text(text.get(), 0, -1, failure.Place()));
}

bool Accessible::SetText(const std::string& text) const {
  Failure failure;
  const Owned<AtspiEditableText> field(atspi_accessible_get_editable_text_iface(object.get()));
  return field != nullptr &&
         atspi_editable_text_set_text_contents(field.get(), text.c_str(), failure.Place()) != 0;
}

bool Accessible::Press() const {
  Failure failure;
  const Owned<AtspiAction> actions(atspi_accessible_get_action_iface(object.get()));
  return actions != nullptr && atspi_action_do_action(actions.get(), 0, failure.Place()) != 0;
}

int Accessible::ColumnCount() const {
  Failure failure;
  const Owned<AtspiTable> table(atspi_accessible_get_table_iface(object.get()));
  return table == nullptr ? -1 : atspi_table_get_n_columns(table.get(), failure.Place());
}

namespace {

bool IsMenuPart(AtspiRole role) {
  return role == ATSPI_ROLE_MENU || role == ATSPI_ROLE_MENU_ITEM || role == ATSPI_ROLE_CHECK_MENU_ITEM ||
         role == ATSPI_ROLE_POPUP_MENU;
}

void AddControls(const Accessible& top, std::size_t parent, std::vector<Control>& controls) {
  Control control;
  control.handle = top;
  control.role = top.Role();
  const std::uint64_t states = top.States();
  const auto is = [states](AtspiStateType state) {
    return (states >> static_cast<unsigned>(state) & 1U) != 0;
  };
  control.isShowing = is(ATSPI_STATE_SHOWING);
  if (!control.isShowing && !IsMenuPart(control.role)) return;
  control.roleName = NameOf(control.role);
  control.name = top.Name();
  if (control.role == ATSPI_ROLE_COMBO_BOX) {
    // Its own name is what is chosen in it, which a reader says after its label.
    const std::vector<std::string> labels = top.Labels();
    if (!labels.empty()) control.name = WithoutColon(labels.front());
  }
  control.isFocusable = is(ATSPI_STATE_FOCUSABLE);
  control.isSensitive = is(ATSPI_STATE_SENSITIVE);
  control.parent = parent;
  if (control.isFocusable && controls.size() > parent) controls[parent].passesFocusOn = true;
  const std::size_t place = controls.size();
  controls.push_back(std::move(control));
  // A cell has only itself, and the menus are the same on every page.
  const bool isWhole = controls[place].role == ATSPI_ROLE_TABLE_CELL ||
                       (controls[place].role == ATSPI_ROLE_MENU_BAR && place > 0);
  if (isWhole) return;
  for (const Accessible& child : top.Children(kMostChildren)) AddControls(child, place, controls);
}

}  // namespace

std::string WithoutColon(std::string label) {
  if (label.ends_with(':')) label.pop_back();
  return label;
}

std::vector<Control> ReadControls(const Accessible& top) {
  std::vector<Control> controls;
  AddControls(top, 0, controls);
  return controls;
}

Accessible FindControl(const Accessible& top, AtspiRole role, const std::string& name) {
  const AtspiRole present = top.Role();
  if (present == role && top.Name() == name) return top.Is(ATSPI_STATE_SHOWING) ? top : Accessible();
  // Rows are no controls, and menus are closed.
  if (present == ATSPI_ROLE_TREE || present == ATSPI_ROLE_TABLE || IsMenuPart(present)) return {};
  for (const Accessible& child : top.Children(kMostChildren)) {
    if (Accessible found = FindControl(child, role, name)) return found;
  }
  return {};
}

bool WaitUntil(const std::function<bool()>& isSo, int milliseconds) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(milliseconds);
  while (true) {
    while (g_main_context_iteration(nullptr, FALSE) != 0) continue;
    if (isSo()) return true;
    if (std::chrono::steady_clock::now() > end) return false;
    std::this_thread::sleep_for(std::chrono::milliseconds(2));
  }
}

}  // namespace tessal::test
