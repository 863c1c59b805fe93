// What was done to a template, step by step: each step is one act of the user, with a name, and can be taken
// back and done again. A step holds what it changed and what it removed, so its cost does not depend on the
// size of the template. Recording is off until somebody starts it, and is off during loads and saves.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_set>
#include <utility>
#include <vector>

#include "core/edits.h"

namespace tessal {

/// What a step has touched that was taken back or done again: for who shows it.
struct StepEffect {
  std::string name;
  Uid subject = Uid::None;     ///< the element that it was about
  std::vector<Uid> changed{};  ///< elements that have other values
  bool structure = false;      ///< elements have come, gone or moved
  bool groups = false;         ///< so have visibility groups, or what belongs to them
  std::int32_t group = 0;      ///< the visibility group that it was about; 0 for none
  bool builtIns = false;       ///< inputs offer other built-ins
};

class EditHistory final {
 public:
  /// How much memory the steps may take, roughly; beyond it the oldest are forgotten.
  static constexpr std::size_t kMostBytes = std::size_t{64} << 20U;

  explicit EditHistory(TemplateState& edited) : state(edited) {}
  EditHistory(const EditHistory&) = delete;
  EditHistory& operator=(const EditHistory&) = delete;

  /// Forgets all steps, and records from now on; what the template holds now counts as saved.
  void Start();
  /// Forgets all steps, and records nothing.
  void Stop();
  bool IsRecording() const { return started && pauses == 0; }

  /// How many steps can be taken back, and how many of those done again.
  std::size_t UndoCount();
  std::size_t RedoCount();
  /// The names of the steps that an undo and a redo are about; empty without one.
  std::string_view UndoName();
  std::string_view RedoName();
  /// How much memory the steps take, roughly.
  std::size_t Bytes() const { return bytes; }

  /// Exchanges what the last step that was done, or the next one, has changed. There must be one. What
  /// follows from it for the whole template is the template's to bring up to date.
  StepEffect Undo();
  StepEffect Redo();

  /// The file holds the template as it is now, or as it is at no step.
  void MarkSaved();
  void ForgetSaved() { saved = kNever; }
  bool IsSaved();

  // Recording. An act that begins within another is part of it. What is edited without an act is one act
  // until the next begins, or somebody asks for the steps.
  void Begin();
  /// Ends the act, and makes a step of it where it has changed anything. Takes what the name of the outermost
  /// act is, empty for one that says what was changed.
  void End(std::string_view name) noexcept;
  void Pause() { ++pauses; }
  void Resume() { --pauses; }
  void NoteValue(CEL_Element& element, CEL_Property& property);
  void NoteInserted(const ListPlace& list, std::size_t place, CEL_Element& element);
  /// Keeps the element, where anything is recorded.
  void NoteRemoved(const ListPlace& list, std::size_t place, std::unique_ptr<CEL_Element> element);
  void NoteMoved(const ListPlace& list, std::size_t from, std::size_t to, CEL_Element& element);
  /// An edit of the groups or of the template's switches.
  void Note(TemplateEdit edit);

 private:
  static constexpr std::size_t kNever = static_cast<std::size_t>(-1);

  struct Step {
    std::string name;
    std::vector<TemplateEdit> edits;
    std::size_t bytes = 0;
  };

  void Clear();
  /// Makes a step of the act that has ended.
  void Close(std::string_view name) noexcept;
  void CloseUnbegun() {
    if (depth == 0 && !open.empty()) Close({});
  }
  void DropUnchanged();
  void Append(std::string_view name);
  void MakeRoom();
  void Measure(Step& step);
  void ForgetOldest();
  /// Has what follows from the values of the step's elements follow them, and says what it has touched.
  static StepEffect Settle(const Step& step);

  TemplateState& state;
  std::vector<Step> steps;
  std::size_t done = 0;
  std::size_t saved = kNever;
  std::size_t bytes = 0;
  bool started = false;
  int pauses = 0;
  int depth = 0;
  std::vector<TemplateEdit> open;                 ///< of the act that is going on
  std::unordered_set<const CEL_Property*> noted;  ///< values that it has changed already
  std::unordered_set<const CEL_Element*> fresh;   ///< elements that it has made
};

/// Nothing is recorded for its lifetime.
class RecordingOff final {
 public:
  explicit RecordingOff(EditHistory& pausedHistory) : history(pausedHistory) { history.Pause(); }
  RecordingOff(const RecordingOff&) = delete;
  RecordingOff& operator=(const RecordingOff&) = delete;
  ~RecordingOff() { history.Resume(); }

 private:
  EditHistory& history;
};

/// One act of the user: all that is edited during its lifetime is one step.
class EditStep final {
 public:
  /// A step without a name is named after what it has changed.
  explicit EditStep(EditHistory& editHistory, std::string stepName = {})
      : history(editHistory), name(std::move(stepName)) {
    history.Begin();
  }
  EditStep(const EditStep&) = delete;
  EditStep& operator=(const EditStep&) = delete;
  ~EditStep() { history.End(name); }

 private:
  EditHistory& history;
  std::string name;
};

}  // namespace tessal
