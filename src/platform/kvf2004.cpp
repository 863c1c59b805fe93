#include "platform/kvf2004.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cmath>
#include <map>
#include <memory>
#include <optional>
#include <utility>
#include <variant>

#include "platform/ascii.h"
#include "platform/file_replacement.h"
#include "platform/kvf_image.h"
#include "platform/kvf_number.h"
#include "platform/kvf_text.h"
#include "platform/kvf_writer.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

/// A file that was read, or one under construction.
using KvfFile = std::variant<std::unique_ptr<KvfImage>, std::unique_ptr<KvfWriter>>;

/// The library's state: the open files, and what went wrong last.
struct Library {
  std::map<KvfHandle, KvfFile> files;
  KvfHandle lastHandle = 0;
  /// The file that was asked for last: a save writes a million items into one.
  KvfHandle lastAsked = 0;
  KvfFile* lastFound = nullptr;
  int lastError = kKvfOk;
  KvfSyntaxError syntaxError;
  std::string writeFailure;
};

Library& TheLibrary() {
  static Library library;
  return library;
}

int Note(int error) {
  TheLibrary().lastError = error;
  return error;
}

/// The file of a handle, as an image or a writer; none for another handle.
template <class File>
File* FileOf(KvfHandle handle) {
  Library& library = TheLibrary();
  if (handle != library.lastAsked || library.lastFound == nullptr) {
    const auto hit = library.files.find(handle);
    library.lastAsked = handle;
    library.lastFound = hit == library.files.end() ? nullptr : &hit->second;
  }
  auto* const file =
      library.lastFound == nullptr ? nullptr : std::get_if<std::unique_ptr<File>>(library.lastFound);
  if (file != nullptr) return file->get();
  Note(kKvfBadHandle);
  return nullptr;
}

/// Keeps a file open, and gives its handle.
KvfHandle Keep(KvfFile file) {
  Library& library = TheLibrary();
  const KvfHandle handle = ++library.lastHandle;
  library.files.emplace(handle, std::move(file));
  return handle;
}

using Type = KvfCell::Type;

bool Is(KvfNode node, Type type) {
  if (node != nullptr && node.Image()->At(node.Place()).ItemType() == type) return true;
  Note(kKvfBadNode);
  return false;
}

bool IsParameter(KvfNode node) {
  return Is(node, Type::Parameter);
}

/// Calls the visitor with each entry of a section, by its place, until it gives true.
template <class Visitor>
std::uint32_t FindEntry(const KvfImage& image, std::uint32_t section, Visitor visit) {
  const std::uint32_t end = image.EndOfSection(section);
  for (std::uint32_t entry = KvfImage::FirstEntry(section); entry < end; entry = image.NextEntry(entry)) {
    if (visit(entry)) return entry;
  }
  return 0;
}

/// The item at a place, or none at the place of the root, which is no node.
KvfNode NodeAt(KvfImage& image, std::uint32_t place) {
  return place == 0 ? KvfNode() : KvfNode(image, place);
}

/// The n-th of a section's keywords or sub-sections that has a name.
KvfNode NthOfName(KvfImage& image, std::uint32_t section, Type type, std::string_view name, int number) {
  return NodeAt(image, image.FindName(section, type, name, number));
}

/// The first section from an entry on, before the end.
KvfNode SectionFrom(KvfImage& image, std::uint32_t entry, std::uint32_t end) {
  while (entry < end && image.At(entry).ItemType() != Type::Section) entry = image.NextEntry(entry);
  return entry < end ? KvfNode(image, entry) : KvfNode();
}

/// A section that somebody asked for.
KvfNode Asked(KvfNode section) {
  if (section != nullptr) section.Image()->At(section.Place()).MarkRead();
  return section;
}

std::string_view RawText(KvfNode node) {
  return node.Image()->TextAt(node.Place());
}

/// Carriage returns are no part of a text.
bool HasReturns(std::string_view text) {
  return text.find('\r') != std::string_view::npos;
}

/// At most that many bytes of what is left of a text without them.
std::string WithoutReturns(std::string_view text, std::size_t longest = std::string_view::npos) {
  std::string changed;
  for (const char character : text) {
    if (changed.size() == longest) break;
    if (character != '\r') changed += character;
  }
  return changed;
}

KvfValueType ValueType(KvfNode parameter) {
  return static_cast<KvfValueType>(parameter.Image()->At(parameter.Place()).Detail());
}

bool IsText(KvfValueType type) {
  return type == KvfValueType::Quoted || type == KvfValueType::Path;
}

void MarkRead(KvfNode parameter) {
  parameter.Image()->At(parameter.Place()).MarkRead();
}

/// Adds a value to the open keyword by `add(writer)`.
template <class Add>
int AddValue(KvfHandle handle, Add add) {
  KvfWriter* writer = FileOf<KvfWriter>(handle);
  if (writer == nullptr) return kKvfBadHandle;
  if (!writer->HasOpenKeyword()) return Note(kKvfBadNode);
  add(*writer);
  return kKvfOk;
}

int OpenSection(KvfHandle handle, std::string_view name, bool asTarget) {
  KvfWriter* writer = FileOf<KvfWriter>(handle);
  if (writer == nullptr) return kKvfBadHandle;
  if (!IsKvfName(name)) return Note(kKvfNotWritable);
  if (asTarget == writer->HasOpenSection()) return Note(kKvfBadNode);
  writer->OpenSection(name);
  return kKvfOk;
}

}  // namespace

KvfHandle kvfLoadFile(const std::string& path, int /*mode*/) {
  Library& library = TheLibrary();
  library.lastError = kKvfOk;
  library.syntaxError = {};
  std::string failure;
  std::optional<std::string> bytes = ReadWholeFile(path, failure);
  if (!bytes) {
    Note(errno == EFBIG ? kKvfTooLarge : kKvfCannotOpen);
    return 0;
  }
  return kvfLoadText(*std::move(bytes));
}

KvfHandle kvfLoadText(std::string bytes) {
  Library& library = TheLibrary();
  library.lastError = kKvfOk;
  library.syntaxError = {};
  auto image = std::make_unique<KvfImage>(std::move(bytes));
  if (ReadKvfImage(*image, library.syntaxError)) return Keep(std::move(image));
  Note(kKvfSyntaxError);
  return 0;
}

int kvfGetErrorGlb() {
  return TheLibrary().lastError;
}

int kvfGetSyntaxErr(KvfHandle handle, int& line, int& position, std::string& text) {
  const Library& library = TheLibrary();
  if (handle != 0 && FileOf<KvfImage>(handle) == nullptr) return kKvfBadHandle;
  line = library.syntaxError.line;
  position = library.syntaxError.position;
  text = library.syntaxError.text;
  return kKvfOk;
}

KvfHandle kvfCreate() {
  return Keep(std::make_unique<KvfWriter>());
}

KvfHandle kvfCreateInto(const TextSink& sink, std::string_view lastComment) {
  return Keep(std::make_unique<KvfWriter>(sink, lastComment));
}

int kvfFinish(KvfHandle handle) {
  KvfWriter* writer = FileOf<KvfWriter>(handle);
  if (writer == nullptr) return kKvfBadHandle;
  writer->Finish();
  return kKvfOk;
}

void kvfClose(KvfHandle* handle) {
  if (handle == nullptr || *handle == 0) return;
  TheLibrary().lastFound = nullptr;
  if (TheLibrary().files.erase(*handle) == 0) Note(kKvfBadHandle);
  *handle = 0;
}

KvfNode kvfTargetByNameNum(KvfHandle handle, std::string_view name, int number) {
  KvfImage* image = FileOf<KvfImage>(handle);
  return image == nullptr ? KvfNode() : Asked(NthOfName(*image, 0, Type::Section, name, number));
}

KvfNode kvfSectionByNameNum(KvfNode node, std::string_view name, int number) {
  if (!Is(node, Type::Section)) return nullptr;
  return Asked(NthOfName(*node.Image(), node.Place(), Type::Section, name, number));
}

int kvfGetNoSections(KvfNode node) {
  return Is(node, Type::Section) ? static_cast<int>(node.Image()->SubSectionCount(node.Place())) : 0;
}

KvfNode kvfSectionByNum(KvfNode node, int number) {
  if (!Is(node, Type::Section) || number < 1) return nullptr;
  KvfImage& image = *node.Image();
  return Asked(NodeAt(image, FindEntry(image, node.Place(), [&image, &number](std::uint32_t entry) {
                        return image.At(entry).ItemType() == Type::Section && --number == 0;
                      })));
}

KvfNode kvfFirstSection(KvfNode node) {
  if (!Is(node, Type::Section)) return nullptr;
  KvfImage& image = *node.Image();
  return Asked(SectionFrom(image, KvfImage::FirstEntry(node.Place()), image.EndOfSection(node.Place())));
}

KvfNode kvfNextSection(KvfNode node, KvfNode parent) {
  if (!Is(node, Type::Section) || !Is(parent, Type::Section)) return nullptr;
  KvfImage& image = *node.Image();
  return Asked(SectionFrom(image, image.EndOfSection(node.Place()), image.EndOfSection(parent.Place())));
}

bool kvfIsSection(KvfNode node) {
  return node != nullptr && node.Image()->At(node.Place()).ItemType() == Type::Section;
}

bool kvfHasSection(KvfNode node, std::string_view name) {
  return Is(node, Type::Section) && NthOfName(*node.Image(), node.Place(), Type::Section, name, 1) != nullptr;
}

std::string kvfGetNameGlb(KvfNode node) {
  const bool named = node != nullptr && node.Image()->At(node.Place()).ItemType() != Type::Parameter;
  return std::string(named ? RawText(node) : std::string_view());
}

int kvfGetLine(KvfNode node) {
  const bool isEntry = node != nullptr && node.Image()->At(node.Place()).ItemType() != Type::Parameter;
  return isEntry ? node.Image()->LineAt(node.Place()) : 0;
}

KvfNode kvfKeywordByNameNum(KvfNode node, std::string_view name, int number) {
  if (!Is(node, Type::Section)) return nullptr;
  return NthOfName(*node.Image(), node.Place(), Type::Keyword, name, number);
}

int kvfGetNoParams(KvfNode node) {
  return Is(node, Type::Keyword) ? static_cast<int>(node.Image()->ParameterCount(node.Place())) : 0;
}

KvfNode kvfParamByNum(KvfNode node, int number) {
  if (!Is(node, Type::Keyword) || number < 1) return nullptr;
  KvfImage& image = *node.Image();
  const auto before = static_cast<std::uint32_t>(number) - 1;
  if (before >= image.ParameterCount(node.Place())) return nullptr;
  return {image, image.FirstParameter(node.Place()) + before};
}

int kvfGetInt(KvfNode parameter, std::int32_t& value) {
  if (!IsParameter(parameter)) return kKvfBadNode;
  if (ValueType(parameter) != KvfValueType::Integer) return Note(kKvfWrongType);
  value = KvfInteger(RawText(parameter));
  MarkRead(parameter);
  return kKvfOk;
}

int kvfGetDouble(KvfNode parameter, double& value) {
  if (!IsParameter(parameter)) return kKvfBadNode;
  const KvfValueType type = ValueType(parameter);
  if (IsText(type) || type == KvfValueType::Boolean) return Note(kKvfWrongType);
  value = KvfReal(RawText(parameter));
  MarkRead(parameter);
  return kKvfOk;
}

int kvfGetText(KvfNode parameter, std::string& buffer, KvfText& value) {
  if (!IsParameter(parameter)) return kKvfBadNode;
  MarkRead(parameter);
  value = {RawText(parameter), true};
  if (HasReturns(value.text)) {
    buffer = WithoutReturns(value.text);
    value = {buffer, false};
  }
  return kKvfOk;
}

int kvfGetString(KvfNode parameter, std::string& value) {
  std::string buffer;
  KvfText text;
  const int result = kvfGetText(parameter, buffer, text);
  if (result == kKvfOk) value = text.text;
  return result;
}

namespace {

/// What of a keyword is unread, if anything is.
std::optional<KvfUnread::What> UnreadOf(const KvfImage& image, std::uint32_t keyword) {
  const std::uint32_t count = image.ParameterCount(keyword);
  const std::uint32_t first = image.FirstParameter(keyword);
  std::uint32_t read = 0;
  for (std::uint32_t place = first; place < first + count; ++place) read += image.At(place).WasRead() ? 1 : 0;
  if (read == count) return std::nullopt;
  return read == 0 ? KvfUnread::What::Keyword : KvfUnread::What::FurtherValues;
}

}  // namespace

void kvfForEachUnread(KvfNode node, const std::function<void(const KvfUnread&)>& visit) {
  if (!Is(node, Type::Section)) return;
  KvfImage& image = *node.Image();
  // Sections may nest deeper than calls.
  std::vector<std::uint32_t> path{node.Place()};
  std::uint32_t entry = KvfImage::FirstEntry(node.Place());
  while (true) {
    while (!path.empty() && entry == image.EndOfSection(path.back())) path.pop_back();
    if (path.empty()) return;
    const KvfNode parent(image, path.back());
    if (image.At(entry).ItemType() == Type::Keyword) {
      const auto what = UnreadOf(image, entry);
      if (what) visit({*what, {image, entry}, parent});
      entry = image.NextEntry(entry);
    } else if (!image.At(entry).WasRead()) {
      visit({KvfUnread::What::Section, {image, entry}, parent});
      entry = image.NextEntry(entry);
    } else {
      path.push_back(entry);
      entry = KvfImage::FirstEntry(entry);
    }
  }
}

void kvfMarkRead(KvfNode keyword) {
  for (int number = 1; number <= kvfGetNoParams(keyword); ++number) MarkRead(kvfParamByNum(keyword, number));
}

std::string kvfGetSource(KvfNode keyword, std::size_t longest) {
  std::string text;
  if (!Is(keyword, Type::Keyword)) return text;
  text += RawText(keyword);
  text += " = ";
  std::string_view separator;
  for (int number = 1; number <= kvfGetNoParams(keyword); ++number) {
    const KvfNode parameter = kvfParamByNum(keyword, number);
    constexpr std::array<std::string_view, 5> kQuotes = {"", "", "", "'", "|"};
    const std::string_view quote = kQuotes.at(static_cast<std::size_t>(ValueType(parameter)));
    text += separator;
    text += quote;
    text += WithoutReturns(RawText(parameter), longest);
    text += quote;
    if (text.size() > longest) return text.substr(0, longest) + "...";
    separator = ", ";
  }
  return text;
}

bool kvfFitsInt(KvfNode parameter) {
  return !IsParameter(parameter) || KvfIntegerFits(RawText(parameter));
}

bool kvfFitsDouble(KvfNode parameter) {
  return !IsParameter(parameter) || KvfRealFits(RawText(parameter));
}

std::string kvfTakeText(KvfHandle* handle) {
  KvfWriter* const writer = handle == nullptr ? nullptr : FileOf<KvfWriter>(*handle);
  std::string text = writer == nullptr ? std::string() : writer->TakeText();
  kvfClose(handle);
  return text;
}

std::shared_ptr<const std::string> kvfShareText(KvfHandle handle) {
  const KvfImage* image = FileOf<KvfImage>(handle);
  return image == nullptr ? nullptr : image->source;
}

bool kvfIsStrict(KvfHandle handle) {
  const KvfImage* image = FileOf<KvfImage>(handle);
  return image != nullptr && image->isStrict;
}

std::string kvfTextBeside(KvfHandle handle, KvfNode target) {
  const KvfImage* image = FileOf<KvfImage>(handle);
  return image == nullptr ? std::string() : KvfTextBeside(*image, target.Place());
}

void kvfForEachRemark(KvfHandle handle, KvfNode target, const std::function<void(const KvfRemark&)>& visit) {
  if (const KvfImage* image = FileOf<KvfImage>(handle)) ForEachKvfRemark(*image, target.Place(), visit);
}

std::size_t kvfGetBytesCut(KvfHandle handle) {
  const KvfImage* image = FileOf<KvfImage>(handle);
  return image == nullptr ? 0 : image->bytesCut;
}

int kvfAddTarget(KvfHandle handle, std::string_view name) {
  return OpenSection(handle, name, true);
}

int kvfAddSection(KvfHandle handle, std::string_view name) {
  return OpenSection(handle, name, false);
}

int kvfEndSection(KvfHandle handle) {
  KvfWriter* writer = FileOf<KvfWriter>(handle);
  if (writer == nullptr) return kKvfBadHandle;
  if (!writer->HasOpenSection()) return Note(kKvfBadNode);
  writer->CloseSection();
  return kKvfOk;
}

int kvfAddKeyword(KvfHandle handle, std::string_view name) {
  KvfWriter* writer = FileOf<KvfWriter>(handle);
  if (writer == nullptr) return kKvfBadHandle;
  writer->EndKeyword();
  if (!writer->HasOpenSection()) return Note(kKvfBadNode);
  if (!IsKvfName(name)) return Note(kKvfNotWritable);
  writer->AddKeyword(name);
  return kKvfOk;
}

int kvfAddInt(KvfHandle handle, std::int32_t value) {
  return AddValue(handle, [value](KvfWriter& writer) { writer.AddNumber(std::to_string(value)); });
}

int kvfAddDouble(KvfHandle handle, double value) {
  if (!std::isfinite(value)) return Note(kKvfNotWritable);
  return AddValue(handle, [value](KvfWriter& writer) { writer.AddNumber(ShortestNumberText(value)); });
}

int kvfAddString(KvfHandle handle, std::string_view value) {
  const KvfTextMarks marks = KvfMarksIn(value);
  if (marks.hasZero || (marks.hasApostrophe && marks.hasBar)) return Note(kKvfNotWritable);
  return AddValue(handle, [value, marks](KvfWriter& writer) {
    const char quote = marks.hasApostrophe ? '|' : '\'';
    marks.hasLineEnd ? writer.AddLines(value, quote) : writer.AddText(value, quote);
  });
}

int kvfWrite(KvfHandle handle, const std::string& path) {
  const KvfWriter* writer = FileOf<KvfWriter>(handle);
  if (writer == nullptr) return kKvfBadHandle;
  TheLibrary().writeFailure = WriteFreshFile(path, writer->Text());
  return TheLibrary().writeFailure.empty() ? kKvfOk : Note(kKvfWriteFailed);
}

std::string kvfGetWriteFailure() {
  return TheLibrary().writeFailure;
}

}  // namespace tessal
