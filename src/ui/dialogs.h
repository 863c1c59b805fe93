// The questions and boxes of the editor. The real ones appear on the screen; tests answer in their place.
#pragma once

#include <QString>
#include <cstdint>

#include "core/document.h"

class QWidget;

namespace tessal {

/// What a question was answered with. A box that is closed without an answer counts as cancelled.
enum class Answer : std::uint8_t { Yes, No, NoToAll, WholeNames, Cancelled };

/// Where to an export goes by proposal, whose folder need not be there yet.
struct ExportQuestion {
  QString title;
  QString proposal;
  QString filter;
  QString option;  ///< the text of a box that is ticked at first; no box for an empty one
};

struct ExportAnswer {
  QString path;  ///< empty when declined
  bool option = true;
};

class UserDialogs : public DocumentDialogs {
 public:
  /// Shows a text in a box with an exclamation icon.
  virtual void Warn(QWidget* parent, const QString& text) = 0;
  /// Shows what could not be done, in a box titled "Error".
  virtual void ShowFailure(QWidget* parent, const QString& text) = 0;
  /// Asks with Yes and No.
  virtual Answer Ask(QWidget* parent, const QString& question) = 0;
  /// Asks one of several questions of a kind, with No to all of them as a further answer.
  virtual Answer AskOneOfMany(QWidget* parent, const QString& question) = 0;
  /// Asks whether a rename changes the uses, with whole names only as a further answer.
  virtual Answer AskToReplace(QWidget* parent, const QString& question) = 0;
  /// Lets the user choose what an undefined symbol shall become; -1 when it is skipped.
  virtual int ChooseKind(QWidget* parent, const QString& symbol, std::uint32_t mask) = 0;
  /// Lets the user choose a documentation file; empty when declined.
  virtual QString ChooseDocumentationFile(QWidget* parent, const QString& start) = 0;
  /// Lets the user choose where a file is written, and how.
  virtual ExportAnswer ChooseExportFile(QWidget* parent, const ExportQuestion& question) = 0;
  /// Shows a long text that can be scrolled and copied.
  virtual void ShowDetails(QWidget* parent, const QString& title, const QString& text) = 0;
  /// Asks the system to open a file or an address; false when it cannot.
  virtual bool OpenWithSystem(const QString& target) = 0;
  /// Opens the help at the topic with this number.
  virtual void ShowHelp(QWidget* parent, int topic) = 0;
};

/// The dialogs on the screen.
UserDialogs& ScreenDialogs();

}  // namespace tessal
