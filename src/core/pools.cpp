#include "core/pools.h"

#include <cstdint>
#include <utility>

#include "core/template_core.h"
#include "expr/scanner.h"
#include "platform/ascii.h"
#include "platform/kvf2004.h"

namespace tessal {

namespace {

constexpr std::string_view kPools = "TESSAL_POOLS";
constexpr std::string_view kPoolPrefix = "POOL_";
constexpr std::string_view kName = "NAME";
constexpr std::string_view kExpression = "EXPRESSION";
constexpr std::string_view kBoundary = "BOUNDARY";
constexpr std::string_view kDescription = "DESCRIPTION";

/// An open key file, which closes itself.
class KeyFile final {
 public:
  explicit KeyFile(KvfHandle opened) : handle(opened) {}
  KeyFile(const KeyFile&) = delete;
  KeyFile& operator=(const KeyFile&) = delete;
  ~KeyFile() { kvfClose(&handle); }

  KvfHandle Handle() const { return handle; }
  std::string TakeText() { return kvfTakeText(&handle); }

 private:
  KvfHandle handle;
};

std::string TextAt(KvfNode section, std::string_view keyword) {
  std::string text;
  const KvfNode key = kvfKeywordByNameNum(section, keyword, 1);
  if (key != nullptr && kvfGetNoParams(key) == 1) kvfGetString(kvfParamByNum(key, 1), text);
  return text;
}

std::vector<std::string> TextsAt(KvfNode section, std::string_view keyword) {
  std::vector<std::string> texts;
  const KvfNode key = kvfKeywordByNameNum(section, keyword, 1);
  const int count = key == nullptr ? 0 : kvfGetNoParams(key);
  for (int number = 1; number <= count; ++number) {
    std::string text;
    kvfGetString(kvfParamByNum(key, number), text);
    if (!text.empty()) texts.push_back(std::move(text));
  }
  return texts;
}

void ReadSection(KvfNode section, PoolsRead& read) {
  for (KvfNode each = kvfFirstSection(section); each != nullptr; each = kvfNextSection(each, section)) {
    const std::string name = kvfGetNameGlb(each);
    if (!EqualIgnoringCase(std::string_view(name).substr(0, kPoolPrefix.size()), kPoolPrefix)) {
      read.notPools.push_back("the section " + name);
      continue;
    }
    Pool pool{TextAt(each, kName), std::string(StripExpressionQuotes(TextAt(each, kExpression))),
              TextsAt(each, kBoundary), TextAt(each, kDescription)};
    read.pools.push_back(std::move(pool));
  }
}

void NoteWhatIsNoPool(const KeyFile& file, KvfNode section, PoolsRead& read) {
  kvfForEachUnread(section, [&read](const KvfUnread& unread) {
    read.notPools.push_back(kvfGetNameGlb(unread.node) + " of " + kvfGetNameGlb(unread.parent));
  });
  kvfForEachRemark(file.Handle(), section, [&read](const KvfRemark& remark) {
    read.notPools.push_back("the comment \"" + std::string(remark.text) + '"');
  });
}

/// The sections of a text but for the pools.
std::string TextWithoutPools(std::string text) {
  for (;;) {
    const KeyFile file(kvfLoadText(text));
    const KvfNode section = kvfTargetByNameNum(file.Handle(), kPools, 1);
    if (section == nullptr) return text;
    text = kvfTextBeside(file.Handle(), section);
  }
}

bool WriteTexts(KvfHandle file, std::string_view keyword, const std::vector<std::string>& texts) {
  bool isWritten = kvfAddKeyword(file, keyword) == kKvfOk;
  for (const std::string& text : texts) isWritten = kvfAddString(file, text) == kKvfOk && isWritten;
  return isWritten;
}

bool WritePool(KvfHandle file, const Pool& pool) {
  return WriteTexts(file, kName, {pool.name}) &&
         WriteTexts(file, kExpression, {'"' + pool.expression + '"'}) &&
         (pool.boundary.empty() || WriteTexts(file, kBoundary, pool.boundary)) &&
         WriteTexts(file, kDescription, {pool.description});
}

/// The section with the pools as text; empty, with the reason, when the format can not hold them.
std::string SectionText(const std::vector<Pool>& pools, std::string& failure) {
  KeyFile file(kvfCreate());
  kvfAddTarget(file.Handle(), kPools);
  std::size_t number = 0;
  for (const Pool& pool : pools) {
    kvfAddSection(file.Handle(), std::string(kPoolPrefix) + std::to_string(++number));
    if (!WritePool(file.Handle(), pool)) {
      failure = "The pool " + pool.name + " has a text with both ' and |, which a template file can not hold";
      return {};
    }
    kvfEndSection(file.Handle());
  }
  kvfEndSection(file.Handle());
  // What the library writes at the head of a file is no part of the section.
  const KeyFile written(kvfLoadText(file.TakeText()));
  return kvfTextBeside(written.Handle(), nullptr);
}

}  // namespace

PoolsRead PoolsOf(const TemplateCore& core) {
  return core.KeptText().empty() ? PoolsRead() : ReadPools(core.KeptText());
}

PoolsRead ReadPools(const std::string& text) {
  PoolsRead read;
  const KeyFile file(kvfLoadText(text));
  if (file.Handle() == 0) {
    int line = 0;
    int position = 0;
    std::string near;
    kvfGetSyntaxErr(0, line, position, near);
    read.faults.push_back("line " + std::to_string(line) + " position " + std::to_string(position) +
                          " is no key-file text: " + near);
    return read;
  }
  for (int number = 1;; ++number) {
    const KvfNode section = kvfTargetByNameNum(file.Handle(), kPools, number);
    if (section == nullptr) return read;
    ReadSection(section, read);
    NoteWhatIsNoPool(file, section, read);
  }
}

bool SetPools(TemplateCore& core, const std::vector<Pool>& pools, std::string& failure) {
  const PoolsRead former = PoolsOf(core);
  if (!former.faults.empty() || !former.notPools.empty()) {
    failure = "The pools can not be changed here, since the file holds beside them what would be lost: " +
              (former.faults.empty() ? former.notPools : former.faults).front();
    return false;
  }
  std::string text = TextWithoutPools(core.KeptText());
  if (!pools.empty()) {
    const std::string section = SectionText(pools, failure);
    if (section.empty()) return false;
    text += (text.empty() ? "" : "\r\n\r\n") + section;
  }
  core.SetKeptText(std::move(text));
  return true;
}

}  // namespace tessal
