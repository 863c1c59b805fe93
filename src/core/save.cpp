// Saving a template: its text is written through the key-file library, joined with what its file held
// beside the template, and put in the target's place in one step.
#include <array>
#include <exception>
#include <new>
#include <optional>
#include <utility>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "elements/list_section.h"
#include "elements/version_stamp.h"
#include "keyfile/keywords.h"
#include "platform/file_replacement.h"

namespace tessal {

namespace {

constexpr std::string_view kSaveSymbol = "SAVE ";
/// The last line of the head of a template's file.
constexpr std::string_view kTypeComment = "type = 2";
constexpr std::string_view kRefused = "the template holds what the file format can not";

/// A file of the library that is written into a sink, closed on every way out.
class Image final {
 public:
  explicit Image(const TextSink& sink) : handle(kvfCreateInto(sink, kTypeComment)) {}
  Image(const Image&) = delete;
  Image& operator=(const Image&) = delete;
  ~Image() { kvfClose(&handle); }

  KvfHandle Handle() const { return handle; }

 private:
  KvfHandle handle;
};

constexpr Message kSaveFailed("save-failed");
constexpr Message kOutOfMemory("out-of-memory");

/// The settings that a save under a new name stamps, so that one that fails can put them back.
class Stamps final {
 public:
  explicit Stamps(const CEL_Miscanellous& misc)
      : tessalVersion(misc.tessalVersion.RealValue()),
        parserVersion(misc.parserVersion.RealValue()),
        documentRevision(misc.documentRevision.IntValue()),
        optimise(misc.optimise.BoolValue()),
        trigonometrics(misc.trigonometrics.Text()) {}

  void PutBack(CEL_Miscanellous& misc) const {
    misc.tessalVersion.SetReal(tessalVersion);
    misc.parserVersion.SetReal(parserVersion);
    misc.documentRevision.SetInt(documentRevision);
    misc.optimise.SetBool(optimise);
    misc.trigonometrics.SetText(trigonometrics);
  }

 private:
  double tessalVersion;
  double parserVersion;
  std::int32_t documentRevision;
  bool optimise;
  std::string trigonometrics;
};

/// The writing of one template.
class Writing final {
 public:
  explicit Writing(TemplateState& source) : state(source) {}

  /// Under a new name: with fresh version stamps and a restarted revision.
  bool SaveAs(const std::string& path);
  bool SaveInPlace(const std::string& path);
  /// Everything that goes into the file, with all but the record numbers left as it was; nothing, with the
  /// reason, when the format cannot hold it.
  std::optional<std::string> CopyText(std::string& reason);

 private:
  /// Everything that goes into the file. False when the format cannot hold it. Raises the revision.
  bool WriteText(const TextSink& sink);
  bool WriteSections(KvfHandle file);

  TemplateState& state;
};

bool Writing::SaveAs(const std::string& path) {
  CEL_Miscanellous& misc = state.misc;
  const bool hadMisc = state.hasMisc;
  const Stamps former(misc);
  // A file that had no settings stays with the meaning that it was written with.
  std::string angleUnit = "Radians";
  if (state.hasMisc) {
    angleUnit = misc.trigonometrics.Text();
  } else {
    state.hasMisc = true;
    misc.Reset();
  }
  misc.tessalVersion.SetReal(SoftwareVersion());
  misc.parserVersion.SetReal(ParserVersion());
  misc.documentRevision.SetInt(0);
  misc.optimise.SetBool(true);
  misc.trigonometrics.SetText(angleUnit);
  if (SaveInPlace(path)) return true;
  state.hasMisc = hadMisc;
  former.PutBack(misc);
  return false;
}

bool Writing::SaveInPlace(const std::string& path) {
  const std::int32_t formerRevision = state.misc.documentRevision.IntValue();
  // Made before the file is replaced: nothing may fail after that.
  std::array<std::string, 2> names;
  std::optional<Message> failed;
  std::string reason;
  try {
    names = {path, path};
    bool isRefused = false;
    reason = ReplaceFile(path, [this, &isRefused](const TextSink& sink) {
      isRefused = !WriteText(sink);
      return !isRefused;
    });
    if (isRefused) reason = kRefused;
    if (!reason.empty()) failed = kSaveFailed;
  } catch (const std::bad_alloc&) {
    failed = kOutOfMemory;
  } catch (const std::exception& failure) {
    reason = failure.what();
    failed = kSaveFailed;
  }
  if (failed) {
    // What is in memory stays unsaved, and its revision uncounted.
    state.misc.documentRevision.SetInt(formerRevision);
    state.flags.modified = true;
    Errors().ReportInFile(kSaveSymbol, 0, {*failed, {reason}});
    return false;
  }
  state.templateFileName.swap(names[0]);
  state.saveFileName.swap(names[1]);
  state.flags.modified = false;
  // From here on the file holds what the template does.
  state.account.Clear();
  return true;
}

bool Writing::WriteText(const TextSink& sink) {
  Image image(sink);
  if (!WriteSections(image.Handle())) return false;
  kvfFinish(image.Handle());
  if (!state.keptText.empty()) {
    sink(state.keptText);
    sink("\r\n\r\n");
  }
  // The file ends in one line more.
  sink("\r\n");
  return true;
}

std::optional<std::string> Writing::CopyText(std::string& reason) {
  const bool formerlyModified = state.flags.modified;
  const std::int32_t formerRevision = state.misc.documentRevision.IntValue();
  std::optional<std::string> text(std::in_place);
  try {
    const bool isWhole = WriteText([&text](std::string_view part) { *text += part; });
    if (!isWhole) {
      reason = kRefused;
      text.reset();
    }
  } catch (const std::bad_alloc&) {
    reason = kOutOfMemory->text;
    text.reset();
  } catch (const std::exception& failure) {
    reason = failure.what();
    text.reset();
  }
  state.misc.documentRevision.SetInt(formerRevision);
  state.flags.modified = formerlyModified;
  return text;
}

bool Writing::WriteSections(KvfHandle file) {
  int status = 0;
  state.AssignIds();
  state.SettleSpatialTree();
  kvfAddTarget(file, section::kTarget);
  state.root.Write(file, status);
  if (state.hasMisc) {
    kvfAddSection(file, section::kMisc);
    state.misc.Write(file, status);
    kvfEndSection(file);
  }
  ForEachHeadedCollection([this, file, &status](const auto& row) {
    WriteList(state.collections.*row.elements, row.section, row.prefix, &state.ListHead(row.writtenHead),
              file, status);
  });
  WriteEquations(state.collections.stateVariables, section::kStateVariableEquations,
                 section::kStateVariableEquationPrefix, file, status);
  if (!state.collections.species.empty()) {
    WithCollection(ElementKind::Specie, [this, file, &status](const auto& row) {
      WriteList(state.collections.*row.elements, row.section, row.prefix, nullptr, file, status);
    });
  }
  kvfEndSection(file);
  return status == 0;
}

}  // namespace

bool TemplateCore::SaveWrapper(const std::string& path) {
  const RecordingOff unrecorded(history);
  Writing writing(state);
  const bool isSaved = path == state.saveFileName ? writing.SaveInPlace(path) : writing.SaveAs(path);
  if (isSaved) history.MarkSaved();
  return isSaved;
}

std::optional<std::string> TemplateCore::CopyText(std::string& reason) {
  const RecordingOff unrecorded(history);
  return Writing(state).CopyText(reason);
}

}  // namespace tessal
