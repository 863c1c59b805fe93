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
  auto& files = TheLibrary().files;
  const auto hit = files.find(handle);
  const auto* file = hit == files.end() ? nullptr : std::get_if<std::unique_ptr<File>>(&hit->second);
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

bool Is(KvfNode node, KvfItem::Type type) {
  if (node != nullptr && node->type == type) return true;
  Note(kKvfBadNode);
  return false;
}

const KvfSection* AsSection(KvfNode node) {
  return Is(node, KvfItem::Type::Section) ? static_cast<const KvfSection*>(node) : nullptr;
}

const KvfKeyword* AsKeyword(KvfNode node) {
  return Is(node, KvfItem::Type::Keyword) ? static_cast<const KvfKeyword*>(node) : nullptr;
}

/// The section of a node, or none, from that entry on.
const KvfEntry* SectionFrom(const KvfEntry* entry) {
  while (entry != nullptr && entry->type != KvfItem::Type::Section) entry = entry->next;
  return entry;
}

/// The n-th of a section's keywords or sub-sections that has a name.
const KvfEntry* NthOfName(const KvfSection& section, KvfItem::Type type, std::string_view name, int number) {
  for (const KvfEntry* entry = section.first; entry != nullptr; entry = entry->next) {
    if (entry->type == type && EqualIgnoringCase(entry->Text(), name) && --number == 0) return entry;
  }
  return nullptr;
}

/// A section that somebody asked for.
KvfNode Asked(KvfNode section) {
  if (section != nullptr) section->wasRead = true;
  return section;
}

bool IsText(const KvfItem& parameter) {
  return parameter.value == KvfItem::Value::Quoted || parameter.value == KvfItem::Value::Path;
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

/// The quote that a text can be written in; 0 when the format cannot hold it.
char QuoteFor(std::string_view text) {
  if (text.find('\0') != std::string_view::npos) return '\0';
  if (text.find('\'') == std::string_view::npos) return '\'';
  return text.find('|') == std::string_view::npos ? '|' : '\0';
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
  const std::size_t bytesCut = bytes.size() - std::min(bytes.find('\0'), bytes.size());
  auto image = std::make_unique<KvfImage>(KvfReadableText(std::move(bytes)));
  image->bytesCut = bytesCut;
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

void kvfClose(KvfHandle* handle) {
  if (handle == nullptr || *handle == 0) return;
  if (TheLibrary().files.erase(*handle) == 0) Note(kKvfBadHandle);
  *handle = 0;
}

KvfNode kvfTargetByNameNum(KvfHandle handle, std::string_view name, int number) {
  const KvfImage* image = FileOf<KvfImage>(handle);
  return image == nullptr ? nullptr : Asked(NthOfName(image->root, KvfItem::Type::Section, name, number));
}

KvfNode kvfSectionByNameNum(KvfNode node, std::string_view name, int number) {
  const KvfSection* section = AsSection(node);
  return section == nullptr ? nullptr : Asked(NthOfName(*section, KvfItem::Type::Section, name, number));
}

int kvfGetNoSections(KvfNode node) {
  const KvfSection* section = AsSection(node);
  return section == nullptr ? 0 : static_cast<int>(section->count);
}

KvfNode kvfSectionByNum(KvfNode node, int number) {
  const KvfSection* parent = AsSection(node);
  if (parent == nullptr || number < 1) return nullptr;
  const KvfEntry* section = SectionFrom(parent->first);
  while (section != nullptr && --number > 0) section = SectionFrom(section->next);
  return Asked(section);
}

KvfNode kvfFirstSection(KvfNode node) {
  const KvfSection* section = AsSection(node);
  return section == nullptr ? nullptr : Asked(SectionFrom(section->first));
}

KvfNode kvfNextSection(KvfNode node) {
  const KvfSection* section = AsSection(node);
  return section == nullptr ? nullptr : Asked(SectionFrom(section->next));
}

bool kvfIsSection(KvfNode node) {
  return node != nullptr && node->type == KvfItem::Type::Section;
}

bool kvfHasSection(KvfNode node, std::string_view name) {
  const KvfSection* section = AsSection(node);
  return section != nullptr && NthOfName(*section, KvfItem::Type::Section, name, 1) != nullptr;
}

std::string kvfGetNameGlb(KvfNode node) {
  const bool named = node != nullptr && node->type != KvfItem::Type::Parameter;
  return std::string(named ? node->Text() : std::string_view());
}

int kvfGetLine(KvfNode node) {
  const bool isEntry = node != nullptr && node->type != KvfItem::Type::Parameter;
  return isEntry ? static_cast<const KvfEntry*>(node)->line : 0;
}

KvfNode kvfKeywordByNameNum(KvfNode node, std::string_view name, int number) {
  const KvfSection* section = AsSection(node);
  return section == nullptr ? nullptr : NthOfName(*section, KvfItem::Type::Keyword, name, number);
}

int kvfGetNoParams(KvfNode node) {
  const KvfKeyword* keyword = AsKeyword(node);
  return keyword == nullptr ? 0 : static_cast<int>(keyword->count);
}

KvfNode kvfParamByNum(KvfNode node, int number) {
  const KvfKeyword* keyword = AsKeyword(node);
  const bool isThere =
      keyword != nullptr && number >= 1 && static_cast<std::uint32_t>(number) <= keyword->count;
  return isThere ? &keyword->Parameters()[static_cast<std::size_t>(number) - 1] : nullptr;
}

int kvfGetInt(KvfNode parameter, std::int32_t& value) {
  if (!Is(parameter, KvfItem::Type::Parameter)) return kKvfBadNode;
  if (parameter->value != KvfItem::Value::Integer) return Note(kKvfWrongType);
  value = KvfInteger(parameter->Text());
  parameter->wasRead = true;
  return kKvfOk;
}

int kvfGetDouble(KvfNode parameter, double& value) {
  if (!Is(parameter, KvfItem::Type::Parameter)) return kKvfBadNode;
  if (IsText(*parameter) || parameter->value == KvfItem::Value::Boolean) return Note(kKvfWrongType);
  value = KvfReal(parameter->Text());
  parameter->wasRead = true;
  return kKvfOk;
}

int kvfGetString(KvfNode parameter, std::string& value) {
  if (!Is(parameter, KvfItem::Type::Parameter)) return kKvfBadNode;
  value = parameter->Text();
  parameter->wasRead = true;
  return kKvfOk;
}

namespace {

/// What of a keyword is unread, if anything is.
std::optional<KvfUnread::What> UnreadOf(const KvfKeyword& keyword) {
  const auto parameters = keyword.Parameters();
  const auto read = static_cast<std::size_t>(
      std::count_if(parameters.begin(), parameters.end(), [](const KvfItem& each) { return each.wasRead; }));
  if (read == parameters.size()) return std::nullopt;
  return read == 0 ? KvfUnread::What::Keyword : KvfUnread::What::FurtherValues;
}

}  // namespace

void kvfForEachUnread(KvfNode node, const std::function<void(const KvfUnread&)>& visit) {
  const KvfSection* section = AsSection(node);
  if (section == nullptr) return;
  struct Step {
    const KvfSection* section;
    const KvfEntry* next;
  };
  // Sections may nest deeper than calls.
  std::vector<Step> path{{section, section->first}};
  while (!path.empty()) {
    const KvfSection* parent = path.back().section;
    const KvfEntry* entry = path.back().next;
    if (entry == nullptr) {
      path.pop_back();
      continue;
    }
    path.back().next = entry->next;
    if (entry->type == KvfItem::Type::Keyword) {
      const auto what = UnreadOf(static_cast<const KvfKeyword&>(*entry));
      if (what) visit({*what, entry, parent});
    } else if (!entry->wasRead) {
      visit({KvfUnread::What::Section, entry, parent});
    } else {
      const auto& child = static_cast<const KvfSection&>(*entry);
      path.push_back({&child, child.first});
    }
  }
}

void kvfMarkRead(KvfNode node) {
  const KvfKeyword* keyword = AsKeyword(node);
  if (keyword == nullptr) return;
  for (const KvfItem& parameter : keyword->Parameters()) parameter.wasRead = true;
}

std::string kvfGetSource(KvfNode node, std::size_t longest) {
  std::string text;
  const KvfKeyword* keyword = AsKeyword(node);
  if (keyword == nullptr) return text;
  text += keyword->Text();
  text += " = ";
  std::string_view separator;
  for (const KvfItem& parameter : keyword->Parameters()) {
    constexpr std::array<std::string_view, 5> kQuotes = {"", "", "", "'", "|"};
    const std::string_view quote = kQuotes.at(static_cast<std::size_t>(parameter.value));
    text += separator;
    text += quote;
    text += parameter.Text().substr(0, longest);
    text += quote;
    if (text.size() > longest) return text.substr(0, longest) + "...";
    separator = ", ";
  }
  return text;
}

bool kvfFitsInt(KvfNode parameter) {
  return !Is(parameter, KvfItem::Type::Parameter) || KvfIntegerFits(parameter->Text());
}

bool kvfFitsDouble(KvfNode parameter) {
  return !Is(parameter, KvfItem::Type::Parameter) || KvfRealFits(parameter->Text());
}

std::string kvfTakeText(KvfHandle* handle) {
  std::string text;
  auto& files = TheLibrary().files;
  const auto hit = handle == nullptr ? files.end() : files.find(*handle);
  if (hit != files.end()) {
    const auto* image = std::get_if<std::unique_ptr<KvfImage>>(&hit->second);
    text = image != nullptr ? std::move((*image)->source)
                            : std::get<std::unique_ptr<KvfWriter>>(hit->second)->TakeText();
  }
  kvfClose(handle);
  return text;
}

std::string kvfTextBeside(KvfHandle handle, KvfNode target) {
  const KvfImage* image = FileOf<KvfImage>(handle);
  return image == nullptr ? std::string() : KvfTextBeside(*image, target);
}

void kvfForEachRemark(KvfHandle handle, KvfNode target, const std::function<void(const KvfRemark&)>& visit) {
  if (const KvfImage* image = FileOf<KvfImage>(handle)) ForEachKvfRemark(*image, target, visit);
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
  const char quote = QuoteFor(value);
  if (quote == '\0') return Note(kKvfNotWritable);
  return AddValue(handle, [value, quote](KvfWriter& writer) { writer.AddText(value, quote); });
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
