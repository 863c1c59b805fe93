// The document that a host opens, saves and closes: one template, and the protocol by which its views hear
// what happened. All substance lies in the template core.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "core/template_core.h"
#include "platform/docview.h"
#include "platform/text_encoding.h"

namespace tessal {

/// The numbers of the hints by which the views of a document speak with each other.
namespace hint {
inline constexpr int kShowMisc = 1;
inline constexpr int kShowParticles = 2;
inline constexpr int kSelectElement = 4;
inline constexpr int kCommit = 5;
inline constexpr int kCreateElement = 7;
inline constexpr int kDeleteItem = 8;
inline constexpr int kMoveUp = 9;
inline constexpr int kMoveDown = 10;
inline constexpr int kAddGroup = 11;
inline constexpr int kDeleteGroup = 12;
inline constexpr int kSelectGroup = 13;
inline constexpr int kRenameGroup = 14;
/// Several elements have come, gone or moved at once.
inline constexpr int kStructure = 15;
}  // namespace hint

/// A hint whose argument is a number: an element's identity, a group's place, or a switch.
struct NumberHint final : UpdateHint {
  explicit NumberHint(std::int32_t value) : number(value) {}
  std::int32_t number;
};

/// What the user wants of a save that would lose something of the file it replaces.
struct LossAnswer {
  enum class Wish { Replace, SaveCopy, Cancel };

  Wish wish = Wish::Cancel;
  std::string copyPath;  ///< where the copy goes
};

/// How the document speaks with its user.
class DocumentDialogs {
 public:
  virtual ~DocumentDialogs() = default;

  virtual void ShowMessage(const std::string& text) = 0;
  virtual bool AskYesNo(const std::string& question) = 0;
  /// Asks what to do about a file that holds what a save would lose, given as lines.
  virtual LossAnswer AskAboutLosses(const std::string& path, const std::vector<std::string>& losses) = 0;

 protected:
  DocumentDialogs() = default;
  DocumentDialogs(const DocumentDialogs&) = default;
  DocumentDialogs& operator=(const DocumentDialogs&) = default;
};

class CTessalDoc final : public CDocument {
 public:
  explicit CTessalDoc(DocumentDialogs& userDialogs) : dialogs(userDialogs) {}

  /// A new document holds nothing that a save would miss.
  bool OnNewDocument() override;
  bool OnOpenDocument(const std::string& path) override;
  /// Asks first when the registry holds anything, and when the file holds what the save would lose; false,
  /// with the file as it was, when the user declines or has a copy saved.
  bool OnSaveDocument(const std::string& path) override;
  std::optional<std::string> Copy(std::string& reason) override;
  bool OnOpenCopy(const std::string& source, const std::string& path) override;
  DocumentComparison CompareWithFile(const std::string& path) const override;
  /// Takes the last step of the template back, or does the next one again, with the mark of the document;
  /// none when there is no step.
  std::optional<StepEffect> Undo();
  std::optional<StepEffect> Redo();
  void NoteOtherFile() override;
  /// Marks the title too. The mark is taken off by the title that a save gives.
  void SetModifiedFlag(bool flag) override;

  TemplateCore& Core() { return core; }
  const TemplateCore& Core() const { return core; }
  /// The encoding of the file that was opened, in which new texts are written; UTF-8 for a new document.
  TextEncoding Encoding() const { return encoding; }

  /// The filter of the overview page: group and level from 1, 0 for all, and whether lower levels count in.
  std::int32_t visibilityGroup = 0;
  std::int32_t visibilityLevel = 0;
  bool visibilityRecursive = false;

 private:
  /// Loads from a file, by one of the template's loads, and reports a failure.
  bool Open(const std::string& source, const std::string& path);
  /// The file of that path holds what a copy of the work in it does not: a save that replaces it must ask.
  void NoteLossesOf(const std::string& path);
  /// Takes the mark off, or puts it on, after a step.
  void FollowMark();
  /// Whether the file may lose what the load did not take over.
  bool MayLose(const std::string& path);

  DocumentDialogs& dialogs;
  TemplateCore core;
  TextEncoding encoding = TextEncoding::Utf8;
};

}  // namespace tessal
