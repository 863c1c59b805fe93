#include "platform/kvf2004.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <memory>
#include <utility>

#include "platform/ascii.h"
#include "platform/file_replacement.h"
#include "platform/kvf_item.h"
#include "platform/kvf_number.h"
#include "platform/kvf_text.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

/// The library's state: the open images, and what went wrong last.
struct Library {
  std::map<KvfHandle, std::unique_ptr<KvfImage>> images;
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

KvfImage* ImageOf(KvfHandle handle) {
  auto& images = TheLibrary().images;
  const auto hit = images.find(handle);
  if (hit != images.end()) return hit->second.get();
  Note(kKvfBadHandle);
  return nullptr;
}

KvfHandle Keep(std::unique_ptr<KvfImage> image) {
  Library& library = TheLibrary();
  const KvfHandle handle = ++library.lastHandle;
  library.images.emplace(handle, std::move(image));
  return handle;
}

KvfNode NthOfName(const std::vector<KvfItem*>& items, std::string_view name, int number) {
  for (const KvfItem* item : items) {
    if (EqualIgnoringCase(item->text, name) && --number == 0) return item;
  }
  return nullptr;
}

/// A section that somebody asked for.
KvfNode Asked(KvfNode section) {
  if (section != nullptr) section->wasRead = true;
  return section;
}

KvfNode Nth(const std::vector<KvfItem*>& items, int number) {
  const auto place = static_cast<std::size_t>(number) - 1;
  return number >= 1 && place < items.size() ? items[place] : nullptr;
}

bool Is(KvfNode node, KvfItem::Type type) {
  if (node != nullptr && node->type == type) return true;
  Note(kKvfBadNode);
  return false;
}

bool IsText(const KvfItem& parameter) {
  return parameter.value == KvfItem::Value::Quoted || parameter.value == KvfItem::Value::Path;
}

/// The keyword that takes the next parameter, or none.
KvfItem* OpenKeyword(KvfHandle handle) {
  KvfImage* image = ImageOf(handle);
  if (image == nullptr) return nullptr;
  if (image->openKeyword == nullptr) Note(kKvfBadNode);
  return image->openKeyword;
}

int AddParameter(KvfHandle handle, KvfItem::Value value, std::string text) {
  KvfItem* keyword = OpenKeyword(handle);
  if (keyword == nullptr) return TheLibrary().lastError;
  TheLibrary().images.at(handle)->AddParameter(*keyword, value, std::move(text));
  return kKvfOk;
}

int OpenSection(KvfHandle handle, std::string_view name, bool asTarget) {
  KvfImage* image = ImageOf(handle);
  if (image == nullptr) return kKvfBadHandle;
  if (!IsKvfName(name)) return Note(kKvfNotWritable);
  if (asTarget != image->openSections.empty()) return Note(kKvfBadNode);
  KvfItem& parent = asTarget ? image->Root() : *image->openSections.back();
  image->openSections.push_back(&image->AddSection(parent, name, 0));
  image->openKeyword = nullptr;
  return kKvfOk;
}

}  // namespace

KvfHandle kvfLoadFile(const std::string& path, int /*mode*/) {
  Library& library = TheLibrary();
  library.lastError = kKvfOk;
  library.syntaxError = {};
  std::string failure;
  const std::optional<std::string> bytes = ReadWholeFile(path, failure);
  if (!bytes) {
    Note(kKvfCannotOpen);
    return 0;
  }
  return kvfLoadText(*bytes);
}

KvfHandle kvfLoadText(std::string_view bytes) {
  Library& library = TheLibrary();
  library.lastError = kKvfOk;
  library.syntaxError = {};
  auto image = std::make_unique<KvfImage>();
  image->source = KvfReadableText(bytes);
  image->bytesCut = bytes.size() - std::min(bytes.find('\0'), bytes.size());
  if (!ReadKvfImage(*image, library.syntaxError)) {
    Note(kKvfSyntaxError);
    return 0;
  }
  return Keep(std::move(image));
}

int kvfGetErrorGlb() {
  return TheLibrary().lastError;
}

int kvfGetSyntaxErr(KvfHandle handle, int& line, int& position, std::string& text) {
  const Library& library = TheLibrary();
  if (handle != 0 && ImageOf(handle) == nullptr) return kKvfBadHandle;
  line = library.syntaxError.line;
  position = library.syntaxError.position;
  text = library.syntaxError.text;
  return kKvfOk;
}

KvfHandle kvfCreate() {
  return Keep(std::make_unique<KvfImage>());
}

void kvfClose(KvfHandle* handle) {
  if (handle == nullptr || *handle == 0) return;
  if (TheLibrary().images.erase(*handle) == 0) Note(kKvfBadHandle);
  *handle = 0;
}

KvfNode kvfTargetByNameNum(KvfHandle handle, std::string_view name, int number) {
  KvfImage* image = ImageOf(handle);
  return image == nullptr ? nullptr : Asked(NthOfName(image->Root().sections, name, number));
}

KvfNode kvfSectionByNameNum(KvfNode node, std::string_view name, int number) {
  return Is(node, KvfItem::Type::Section) ? Asked(NthOfName(node->sections, name, number)) : nullptr;
}

int kvfGetNoSections(KvfNode node) {
  return Is(node, KvfItem::Type::Section) ? static_cast<int>(node->sections.size()) : 0;
}

KvfNode kvfSectionByNum(KvfNode node, int number) {
  return Is(node, KvfItem::Type::Section) ? Asked(Nth(node->sections, number)) : nullptr;
}

bool kvfIsSection(KvfNode node) {
  return node != nullptr && node->type == KvfItem::Type::Section;
}

bool kvfHasSection(KvfNode node, std::string_view name) {
  return Is(node, KvfItem::Type::Section) && NthOfName(node->sections, name, 1) != nullptr;
}

std::string kvfGetNameGlb(KvfNode node) {
  const bool named = node != nullptr && node->type != KvfItem::Type::Parameter;
  return named ? node->text : std::string();
}

int kvfGetLine(KvfNode node) {
  return node == nullptr ? 0 : node->line;
}

KvfNode kvfKeywordByNameNum(KvfNode section, std::string_view name, int number) {
  return Is(section, KvfItem::Type::Section) ? NthOfName(section->keywords, name, number) : nullptr;
}

int kvfGetNoParams(KvfNode keyword) {
  return Is(keyword, KvfItem::Type::Keyword) ? static_cast<int>(keyword->keywords.size()) : 0;
}

KvfNode kvfParamByNum(KvfNode keyword, int number) {
  return Is(keyword, KvfItem::Type::Keyword) ? Nth(keyword->keywords, number) : nullptr;
}

int kvfGetInt(KvfNode parameter, std::int32_t& value) {
  if (!Is(parameter, KvfItem::Type::Parameter)) return kKvfBadNode;
  if (parameter->value != KvfItem::Value::Integer) return Note(kKvfWrongType);
  value = KvfInteger(parameter->text);
  parameter->wasRead = true;
  return kKvfOk;
}

int kvfGetDouble(KvfNode parameter, double& value) {
  if (!Is(parameter, KvfItem::Type::Parameter)) return kKvfBadNode;
  if (IsText(*parameter) || parameter->value == KvfItem::Value::Boolean) return Note(kKvfWrongType);
  value = KvfReal(parameter->text);
  parameter->wasRead = true;
  return kKvfOk;
}

int kvfGetString(KvfNode parameter, std::string& value) {
  if (!Is(parameter, KvfItem::Type::Parameter)) return kKvfBadNode;
  value = parameter->text;
  parameter->wasRead = true;
  return kKvfOk;
}

std::vector<KvfUnread> kvfGetUnread(KvfNode section) {
  std::vector<KvfUnread> unread;
  if (!Is(section, KvfItem::Type::Section)) return unread;
  struct Step {
    KvfNode section;
    std::size_t next;
  };
  // Sections may nest deeper than calls.
  std::vector<Step> path{{section, 0}};
  while (!path.empty()) {
    const KvfNode parent = path.back().section;
    if (path.back().next >= parent->order.size()) {
      path.pop_back();
      continue;
    }
    const KvfNode item = parent->order[path.back().next++];
    if (item->type == KvfItem::Type::Section) {
      if (item->wasRead) {
        path.push_back({item, 0});
      } else {
        unread.push_back({KvfUnread::What::Section, item, parent});
      }
      continue;
    }
    const auto& values = item->keywords;
    const auto read =
        std::count_if(values.begin(), values.end(), [](const KvfItem* v) { return v->wasRead; });
    if (static_cast<std::size_t>(read) == values.size()) continue;
    unread.push_back({read == 0 ? KvfUnread::What::Keyword : KvfUnread::What::FurtherValues, item, parent});
  }
  return unread;
}

void kvfMarkRead(KvfNode keyword) {
  if (!Is(keyword, KvfItem::Type::Keyword)) return;
  for (const KvfItem* value : keyword->keywords) value->wasRead = true;
}

std::string kvfGetSource(KvfNode keyword) {
  std::string text;
  if (Is(keyword, KvfItem::Type::Keyword)) AppendKvfKeyword(*keyword, text);
  return text;
}

bool kvfFitsInt(KvfNode parameter) {
  return !Is(parameter, KvfItem::Type::Parameter) || KvfIntegerFits(parameter->text);
}

bool kvfFitsDouble(KvfNode parameter) {
  return !Is(parameter, KvfItem::Type::Parameter) || KvfRealFits(parameter->text);
}

std::string kvfTakeText(KvfHandle handle) {
  KvfImage* image = ImageOf(handle);
  return image == nullptr ? std::string() : std::exchange(image->source, {});
}

std::string kvfTextBeside(KvfHandle handle, KvfNode target) {
  const KvfImage* image = ImageOf(handle);
  return image == nullptr ? std::string() : KvfTextBeside(*image, target);
}

std::vector<KvfRemark> kvfGetRemarks(KvfHandle handle, KvfNode target) {
  const KvfImage* image = ImageOf(handle);
  return image == nullptr ? std::vector<KvfRemark>() : KvfRemarksOf(*image, target);
}

std::size_t kvfGetBytesCut(KvfHandle handle) {
  const KvfImage* image = ImageOf(handle);
  return image == nullptr ? 0 : image->bytesCut;
}

int kvfAddTarget(KvfHandle handle, std::string_view name) {
  return OpenSection(handle, name, true);
}

int kvfAddSection(KvfHandle handle, std::string_view name) {
  return OpenSection(handle, name, false);
}

int kvfEndSection(KvfHandle handle) {
  KvfImage* image = ImageOf(handle);
  if (image == nullptr) return kKvfBadHandle;
  if (image->openSections.empty()) return Note(kKvfBadNode);
  image->openSections.pop_back();
  image->openKeyword = nullptr;
  return kKvfOk;
}

int kvfAddKeyword(KvfHandle handle, std::string_view name) {
  KvfImage* image = ImageOf(handle);
  if (image == nullptr) return kKvfBadHandle;
  image->openKeyword = nullptr;
  if (image->openSections.empty()) return Note(kKvfBadNode);
  if (!IsKvfName(name)) return Note(kKvfNotWritable);
  image->openKeyword = &image->AddKeyword(*image->openSections.back(), name, 0);
  return kKvfOk;
}

int kvfAddInt(KvfHandle handle, std::int32_t value) {
  return AddParameter(handle, KvfItem::Value::Integer, std::to_string(value));
}

int kvfAddDouble(KvfHandle handle, double value) {
  if (!std::isfinite(value)) return Note(kKvfNotWritable);
  return AddParameter(handle, KvfItem::Value::Real, ShortestNumberText(value));
}

int kvfAddString(KvfHandle handle, std::string_view value) {
  const bool hasQuote = value.find('\'') != std::string_view::npos;
  const bool hasBar = value.find('|') != std::string_view::npos;
  if ((hasQuote && hasBar) || value.find('\0') != std::string_view::npos) return Note(kKvfNotWritable);
  return AddParameter(handle, hasQuote ? KvfItem::Value::Path : KvfItem::Value::Quoted, std::string(value));
}

int kvfWrite(KvfHandle handle, const std::string& path) {
  KvfImage* image = ImageOf(handle);
  if (image == nullptr) return kKvfBadHandle;
  TheLibrary().writeFailure = WriteFreshFile(path, WriteKvfImage(*image));
  return TheLibrary().writeFailure.empty() ? kKvfOk : Note(kKvfWriteFailed);
}

std::string kvfGetText(KvfHandle handle) {
  KvfImage* image = ImageOf(handle);
  return image == nullptr ? std::string() : WriteKvfImage(*image);
}

std::string kvfGetWriteFailure() {
  return TheLibrary().writeFailure;
}

}  // namespace tessal
