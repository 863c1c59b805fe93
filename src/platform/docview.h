// Documents and their views: a document owns data and notifies its views of changes through numbered hints;
// a view shows it. A document template makes documents and views of one kind for a host application.
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

class QAction;
class QWidget;

namespace tessal {

class CView;

/// What comes with a hint. Each kind of hint has a type of its own.
class UpdateHint {
 public:
  virtual ~UpdateHint() = default;

 protected:
  UpdateHint() = default;
  UpdateHint(const UpdateHint&) = default;
  UpdateHint& operator=(const UpdateHint&) = default;
};

/// One row of what a document holds otherwise than a file does. All texts are UTF-8, for people.
struct DocumentDifference {
  std::string change;  ///< a word: what became of the item from the file to the document
  std::string kind;
  std::string name;
  std::string field;  ///< empty where the item as a whole was added or removed
  std::string before;
  std::string after;
};

/// The differences between a file and a document; or, where the file could not be read, why.
struct DocumentComparison {
  std::vector<DocumentDifference> differences;
  std::string failure;
};

class CDocument {
 public:
  CDocument() = default;
  CDocument(const CDocument&) = delete;
  CDocument& operator=(const CDocument&) = delete;
  virtual ~CDocument() = default;

  /// Each returns false when it failed; the host then keeps things as they were.
  virtual bool OnNewDocument() { return true; }
  virtual bool OnOpenDocument(const std::string& path);
  virtual bool OnSaveDocument(const std::string& path) = 0;
  virtual void OnCloseDocument() {}

  /// What a save would write, with the document left as it is. Nothing, with the reason in words, when that
  /// cannot be written.
  virtual std::optional<std::string> Copy(std::string& reason);
  /// Opens the content of a file as that of another, whose name the host gives the document; of none where
  /// `path` is empty.
  virtual bool OnOpenCopy(const std::string& source, const std::string& path);
  /// What has changed from a file of this kind to the document, which stays as it is.
  virtual DocumentComparison CompareWithFile(const std::string& path) const;

  virtual bool IsModified() const { return modified; }
  virtual void SetModifiedFlag(bool flag) { modified = flag; }

  /// The document's file has come to hold something else, which the document does not follow.
  virtual void NoteOtherFile() { SetModifiedFlag(true); }

  const std::string& Title() const { return title; }
  void SetTitle(const std::string& text) { title = text; }
  const std::string& PathName() const { return pathName; }
  /// Also gives the document the file's plain name as its title.
  void SetPathName(const std::string& path);

  /// Views look on: whoever makes one keeps it, and takes it off before it goes.
  void AddView(CView& view);
  void RemoveView(CView& view);
  const std::vector<CView*>& Views() const { return views; }

  /// Notifies every view but the sender.
  void UpdateAllViews(const CView* sender, int hint = 0, const UpdateHint* argument = nullptr);

 private:
  bool modified = false;
  std::string title;
  std::string pathName;
  std::vector<CView*> views;
};

/// A command of a view that a host shows in its menus and runs for the document in front. Texts are UTF-8; in
/// menu and text an ampersand marks the shortcut key.
struct ViewCommand {
  std::string menu;
  std::string text;  ///< empty for a line between commands
  std::function<void()> run{};
  bool checkable = false;
  bool checked = false;
  /// An action of the view's own, which the menu shows as it is at any time; then there is no text.
  QAction* action = nullptr;
};

class CView {
 public:
  CView() = default;
  CView(const CView&) = delete;
  CView& operator=(const CView&) = delete;
  virtual ~CView() = default;

  virtual void OnUpdate(const CView* sender, int hint, const UpdateHint* argument) = 0;
  /// Builds what the view shows. Called once, when it is in its frame.
  virtual void OnInitialUpdate() {}
  /// Puts what the user has entered and not yet committed into the document, before a save or a close.
  virtual void OnCommit() {}
  /// Whether there is something that the user has entered and not yet committed.
  virtual bool HasUncommitted() const { return false; }
  /// Runs something while the document holds what the user has entered and not yet committed. After it both
  /// are as before; the user sees nothing of it.
  virtual void WithUncommitted(const std::function<void()>& run) { run(); }
  /// The view comes to the front among the views of other documents.
  virtual void OnActivate() {}
  /// What the view offers for the menus of a host, in order. Asked for again after a command has run.
  virtual std::vector<ViewCommand> Commands() { return {}; }
  /// What a host shows of the view all the time in its status bar.
  virtual std::string StatusText() const { return {}; }
  /// Which part of the document is in front, as a text by which another run finds it again; empty for none.
  virtual std::string Place() const { return {}; }
  virtual void GoTo(const std::string& /*place*/) {}
  /// The widget that a host puts into its frame; none for a view without a screen.
  virtual QWidget* Widget() { return nullptr; }

  /// How a view has the frame around it show the document's title again.
  void SetFrameTitleUpdate(std::function<void()> update) { frameTitleUpdate = std::move(update); }
  void UpdateFrameTitle() {
    if (frameTitleUpdate) frameTitleUpdate();
  }

  /// How a view has the frame around it show its status, with a message for a while; empty for none.
  void SetStatusUpdate(std::function<void(const std::string& message)> update) {
    statusUpdate = std::move(update);
  }
  void UpdateStatus(const std::string& message = {}) {
    if (statusUpdate) statusUpdate(message);
  }

 private:
  std::function<void()> frameTitleUpdate;
  std::function<void(const std::string& message)> statusUpdate;
};

/// What a host needs to know of one kind of documents.
class CMultiDocTemplate final {
 public:
  using DocumentFactory = std::function<std::unique_ptr<CDocument>()>;
  using ViewFactory = std::function<std::unique_ptr<CView>(CDocument&)>;

  /// The resource text holds seven names, separated by line feeds: window title, document name, new-file
  /// name, filter name, extension, and two identifiers of the file type.
  CMultiDocTemplate(int resourceNumber, const std::string& resourceText, DocumentFactory documentFactory,
                    ViewFactory viewFactory);

  enum Name {
    kWindowTitle,
    kDocumentName,
    kNewFileName,
    kFilterName,
    kFilterExtension,
    kFileTypeId,
    kFileTypeName
  };

  int ResourceNumber() const { return resource; }
  /// One of the names; empty when the resource text has none.
  std::string GetDocString(Name name) const;
  std::unique_ptr<CDocument> CreateNewDocument() const { return makeDocument(); }
  /// A view on a document of this template, known to the document from here on.
  std::unique_ptr<CView> CreateView(CDocument& document) const;

 private:
  int resource;
  std::vector<std::string> names;
  DocumentFactory makeDocument;
  ViewFactory makeView;
};

}  // namespace tessal
