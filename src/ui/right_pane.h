// What all forms of the right pane share: how a form is loaded from one element and written back to it, when
// a change counts, and the prompts about names. The model is written by the commit only.
#pragma once

#include <QWidget>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "core/text_walk.h"
#include "ui/item_data.h"

namespace tessal {

class CEL_Element;
class CEL_Property;
class CTessalDoc;
class TemplateCore;
class UserDialogs;
enum class Answer : std::uint8_t;
struct CreationOffer;

/// What a form works on: the document, the node that it shows, and who speaks with the user.
struct FormContext {
  CTessalDoc& document;
  UserDialogs& dialogs;
  CItemData& item;
};

/// A value that the user has typed and not yet committed: how it gets into the model for a moment, unseen by
/// listeners, and out of it again.
struct TypedValue {
  std::function<void()> store;
  std::function<void()> takeBack;
};

/// A part of a text that a form is to show: its place in the template, and in characters what is marked.
struct TextToShow {
  TextPlace place;
  const CEL_Property* property;  ///< none in a visibility group
  int start;
  int length;
};

class CRightPaneBase : public QWidget {
  Q_OBJECT

 public:
  CRightPaneBase(const FormContext& context, QWidget* parent);
  ~CRightPaneBase() override;

  /// Fills the form from its element. No control counts as edited meanwhile.
  void Load();
  /// Writes the form to its element, offers to create undefined symbols, and loads again what has changed.
  /// A commit that comes while one is running does nothing.
  void Commit();
  /// Whether the commit has left something to the next one: a rename leaves what was typed into expressions.
  virtual bool HasUnwritten() const { return false; }
  /// What the next commit would write, without the symbol: a rename asks first.
  virtual std::vector<TypedValue> TypedValues() const { return {}; }

  /// The elements that are selected in the form itself: those of a list's rows.
  virtual std::vector<Uid> SelectedElements() const { return {}; }
  /// Gives the field of a text the focus, and marks a part of the text; the field, or none without one.
  virtual QWidget* ShowText(const TextToShow& /*text*/) { return nullptr; }

  /// Elements or groups were made, moved or deleted elsewhere: a page that lists them shows them again.
  virtual void OnStructureChanged() {}

  /// From now on nothing that its controls report counts: its node may go before it does.
  void Close() { closed = true; }
  bool IsClosed() const { return closed; }

 protected:
  virtual void ItemToForm() {}
  virtual void FormToItem() {}

  CTessalDoc& Document() const { return where.document; }
  TemplateCore& Core() const;
  UserDialogs& Dialogs() const { return where.dialogs; }
  /// The node that the form shows.
  CItemData& Item() const { return where.item; }
  /// The element of the node; none for a node that is no element.
  virtual CEL_Element* Element() const;

  // What controls report. Nothing counts while the form is being filled or written.
  void NoteEdited();
  /// Something was typed where leaving the field writes nothing: only the document's mark shows it.
  void NoteTyped();
  void NoteFocusLost();
  void NoteChosen();
  /// Has the main view commit the form, and show what follows from it.
  void RequestCommit();
  void JumpTo(Uid uid);

  /// Asks what a new symbol needs asking, and renames; shows a message when the name is refused. True when
  /// what uses the element follows to the new name.
  bool Rename(const std::string& newSymbol);

 private:
  /// Asks about each undefined symbol that was not asked about yet; true when an element was created.
  bool OfferUndefinedSymbols();
  /// Asks whether a rename changes the uses; the question shows which longer names it would change too.
  Answer AskToReplace(const std::string& oldSymbol, const std::string& newSymbol);
  Answer AskAbout(const CreationOffer& offer);
  bool IsDeaf() const { return loading || committing || closed; }

  FormContext where;
  bool dirty = false;
  bool loading = false;
  bool committing = false;
  bool closed = false;
};

}  // namespace tessal
