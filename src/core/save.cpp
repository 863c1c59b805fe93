// Saving a template: written through the key-file library into a temporary file beside the target, joined
// with the top-level sections that only the kept tree knows, and put in the target's place in one step.
#include <cstdio>
#include <exception>
#include <locale>
#include <sstream>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "elements/version_stamp.h"
#include "keyfile/keywords.h"
#include "platform/ascii.h"
#include "platform/file_replacement.h"

namespace tessal {

namespace {

constexpr std::string_view kSaveSymbol = "SAVE ";
constexpr std::string_view kTypeLine = "// type = 2\r\n";
/// The type line comes before this line, counted from 1.
constexpr int kTypeLineNumber = 4;

/// An image of the library, closed on every way out.
class Image final {
 public:
  Image() : handle(kvfCreate()) {}
  Image(const Image&) = delete;
  Image& operator=(const Image&) = delete;
  ~Image() { kvfClose(&handle); }

  KvfHandle Handle() const { return handle; }

 private:
  KvfHandle handle;
};

void ReportFailure(std::string_view reason) {
  Errors().ReportInFile(kSaveSymbol, 0, {"save-failed", {reason}});
}

/// The text with the type line before its fourth line. A text of fewer lines gets none. One more, empty, line
/// follows a text that ends in a line end.
std::string WithTypeLine(const std::string& text) {
  std::size_t lineStart = 0;
  for (int line = 1; line < kTypeLineNumber; ++line) {
    const std::size_t lineEnd = text.find('\n', lineStart);
    if (lineEnd == std::string::npos) return text;
    lineStart = lineEnd + 1;
  }
  std::string result = text.substr(0, lineStart);
  result += kTypeLine;
  result.append(text, lineStart);
  result += "\r\n";
  return result;
}

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

/// Each line feed as carriage return and line feed.
std::string WithCarriageReturns(const std::string& text) {
  std::string result;
  result.reserve(text.size() + text.size() / 16);
  for (const char character : text) {
    if (character == '\n') result += '\r';
    result += character;
  }
  return result;
}

template <class Elements>
void WriteElements(const Elements& elements, std::string_view prefix, KvfHandle file, int& status) {
  for (std::size_t place = 0; place < elements.size(); ++place) {
    kvfAddSection(file, std::string(prefix) + std::to_string(place + 1));
    elements[place]->Write(file, status);
    kvfEndSection(file);
  }
}

}  // namespace

bool TemplateCore::SaveWrapper(const std::string& path) {
  return Save(path);
}

bool TemplateCore::Save(const std::string& path) {
  return path == saveFileName ? WriteTemplateFile(path) : SaveAs(path);
}

bool TemplateCore::SaveAs(const std::string& path) {
  const bool hadMisc = hasMisc;
  const Stamps former(misc);
  // A file that had no settings stays with the meaning that it was written with.
  std::string angleUnit = "Radians";
  if (hasMisc) {
    angleUnit = misc.trigonometrics.Text();
  } else {
    hasMisc = true;
    misc.Reset();
  }
  misc.tessalVersion.SetReal(SoftwareVersion());
  misc.parserVersion.SetReal(ParserVersion());
  misc.documentRevision.SetInt(0);
  misc.optimise.SetBool(true);
  misc.trigonometrics.SetText(angleUnit);
  if (WriteTemplateFile(path)) return true;
  hasMisc = hadMisc;
  former.PutBack(misc);
  return false;
}

bool TemplateCore::WriteTemplateFile(const std::string& path) {
  const std::int32_t formerRevision = misc.documentRevision.IntValue();
  std::string reason;
  try {
    reason = WriteThrough(path);
  } catch (const std::exception& failure) {
    reason = failure.what();
  }
  if (!reason.empty()) {
    // What is in memory stays unsaved, and its revision uncounted.
    misc.documentRevision.SetInt(formerRevision);
    flags.modified = true;
    ReportFailure(reason);
    return false;
  }
  templateFileName = path;
  saveFileName = path;
  flags.modified = false;
  return true;
}

std::string TemplateCore::WriteThrough(const std::string& path) {
  const std::string temporary = path + "$";
  std::string text;
  {
    const Image image;
    if (!WriteSections(image.Handle())) return "the template holds what the file format can not";
    if (kvfWrite(image.Handle(), temporary) != kKvfOk) return kvfGetWriteFailure();
    // Not read back from the temporary file: another save of the same template may be writing it by now.
    text = kvfGetText(image.Handle());
  }
  std::string reason = ReplaceFile(path, WithTypeLine(text + KeptSectionsText()));
  const std::string removal = RemoveFile(temporary);
  if (!removal.empty()) std::fprintf(stderr, "could not delete temporary file %s\n", temporary.c_str());
  return reason;
}

std::string TemplateCore::KeptSectionsText() const {
  std::ostringstream text;
  text.imbue(std::locale::classic());
  // The first target of the template's name is the one that was read; it is not always the first of all.
  bool targetSeen = false;
  for (const auto& child : keptTree.Children()) {
    if (child->ItemKind() != CKvfBaseItem::kSection) continue;
    const bool isTarget = !targetSeen && EqualIgnoringCase(child->name, section::kTarget);
    targetSeen = targetSeen || isTarget;
    if (!isTarget) child->Write(text);
  }
  return WithCarriageReturns(text.str());
}

bool TemplateCore::WriteSections(KvfHandle file) {
  int status = 0;
  AssignIds();
  kvfAddTarget(file, section::kTarget);
  root.Write(file, status);
  if (hasMisc) {
    kvfAddSection(file, section::kMisc);
    misc.Write(file, status);
    kvfEndSection(file);
  }
  WriteCollections(file, status);
  WriteEquations(file, status);
  WriteSpecies(file, status);
  kvfEndSection(file);
  return status == 0;
}

void TemplateCore::WriteCollections(KvfHandle file, int& status) {
  const auto write = [this, file, &status](const auto& elements, std::string_view name,
                                           std::string_view prefix, ElementKind headKind) {
    kvfAddSection(file, name);
    ListHead(headKind).Write(file, status);
    WriteElements(elements, prefix, file, status);
    kvfEndSection(file);
  };
  write(stateVariables, section::kStateVariables, section::kStateVariablePrefix,
        ElementKind::StateVariableList);
  write(constants, section::kConstants, section::kConstantPrefix, ElementKind::ConstantList);
  write(forcings, section::kForcings, section::kForcingPrefix, ElementKind::ForcingList);
  // The texts of the auxiliaries' head are those of the constants: files have always been written so.
  write(auxiliaries, section::kAuxiliaryVariables, section::kAuxiliaryVariablePrefix,
        ElementKind::ConstantList);
  write(processes, section::kProcesses, section::kProcessPrefix, ElementKind::ProcessList);
  write(derivedOutputs, section::kDerivedOutputs, section::kDerivedOutputPrefix,
        ElementKind::DerivedOutputList);
}

void TemplateCore::WriteEquations(KvfHandle file, int& status) {
  kvfAddSection(file, section::kStateVariableEquations);
  for (std::size_t place = 0; place < stateVariables.size(); ++place) {
    kvfAddSection(file, std::string(section::kStateVariableEquationPrefix) + std::to_string(place + 1));
    stateVariables[place]->WriteEquation(file, status);
    kvfEndSection(file);
  }
  kvfEndSection(file);
}

void TemplateCore::WriteSpecies(KvfHandle file, int& status) {
  if (species.empty()) return;
  kvfAddSection(file, section::kLagrange);
  WriteElements(species, section::kSpeciePrefix, file, status);
  kvfEndSection(file);
}

}  // namespace tessal
