// An editor that is driven by the lines of a script, and its pictures. A line is a verb and what it is about:
//
//     new                        a new template, alone in a new window
//     open NAME                  a template of the examples, in the same way
//     palette light|dark         the colours of the windows that follow
//     size WIDTH HEIGHT          of the window
//     select NODE                a node of the tree, by its caption or the end of its path
//     expand NODE, collapse NODE
//     type FIELD: TEXT           replaces what a field or a line holds; the focus stays there
//     enter FIELD: TEXT          the same, and leaves it
//     focus FIELD
//     keys TEXT                  typed where the focus is; <Ctrl+K> is a key by its name
//     choose FIELD: ENTRY        of a list of choices
//     press BUTTON               by its text or name
//     tab TEXT                   shows the page with that tab
//     command TEXT               of the menus
//     answer BUTTON, BUTTON      to the next question; "answer FILE: BUTTON" takes a picture of it first
//     pause MILLISECONDS
//     picture FILE               of the window, with what is open over it
//     part FILE: NAME            of one part of it: page, tree, messages, find, analyses, or a control's name
//     save NAME                  as a template of the examples
#pragma once

#include <QString>
#include <memory>

#include "app/host_window.h"
#include "pictures/question_answers.h"

class QTreeWidgetItem;

namespace tessal {
class CMainView;
}

namespace tessal::pictures {

class EditorPictures final {
 public:
  /// Reads the examples of a folder, and writes below another.
  EditorPictures(QString examplesFolder, QString outputFolder);

  /// Carries out a line of the script; throws std::runtime_error with the reason when it cannot be done.
  void Do(const QString& line);
  /// Closes the window; throws when an answer is left, whose question nobody asked.
  void Finish();

 private:
  void Start();
  void Open(const QString& name);
  CMainView& View() const;
  QWidget& Control(const QString& name) const;
  QTreeWidgetItem& Node(const QString& caption) const;
  void Type(const QString& name, const QString& text);
  void PressKeys(const QString& keys);
  void Choose(const QString& name, const QString& entry);
  void Press(const QString& name);
  void ShowTab(const QString& text);
  void RunCommand(const QString& text);
  void AddAnswer(const QString& words);
  void UsePalette(const QString& name);
  void TakeWindow(const QString& file);
  void TakePart(const QString& file, const QString& name);
  void Write(const QPixmap& picture, const QString& file) const;
  void Save(const QString& name);

  QString examples;
  QString output;
  std::unique_ptr<HostWindow> window;
  QuestionAnswers answers;
};

}  // namespace tessal::pictures
