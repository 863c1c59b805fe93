// Any bytes are loaded or refused with a place; every item of a loaded file answers every question, and a
// text that is called strict is one for the reader of the item tree.
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>
#include <vector>

#include "keyfile/reader.h"
#include "platform/kvf2004.h"

namespace {

using namespace tessal;

void Require(bool holds) {
  if (!holds) std::abort();
}

void ReadParameters(KvfNode section, std::string_view name) {
  const KvfNode keyword = kvfKeywordByNameNum(section, name, 1);
  for (int number = 1; number <= (keyword == nullptr ? 0 : kvfGetNoParams(keyword)); ++number) {
    const KvfNode parameter = kvfParamByNum(keyword, number);
    std::int32_t integer = 0;
    double real = 0.0;
    std::string text;
    const bool isInteger = kvfGetInt(parameter, integer) == kKvfOk;
    Require(!isInteger || kvfGetDouble(parameter, real) == kKvfOk);
    Require(kvfGetString(parameter, text) == kKvfOk);
    Require(kvfGetInt(section, integer) != kKvfOk);
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  KvfHandle file = kvfLoadText({reinterpret_cast<const char*>(data), size});
  int line = 0;
  int position = 0;
  std::string near;
  Require(kvfGetSyntaxErr(file, line, position, near) == kKvfOk);
  if (file == 0) {
    Require(kvfGetErrorGlb() == kKvfSyntaxError && line >= 1 && position >= 1 && near.size() <= 40);
    return 0;
  }
  if (kvfIsStrict(file)) {
    Require(CheckKeyFileText(*kvfShareText(file)) == 1);
  }
  std::vector<KvfNode> open;
  for (const char* name : {"T", "TESSAL_SETUP", "A"}) {
    if (const KvfNode target = kvfTargetByNameNum(file, name, 1)) open.push_back(target);
  }
  while (!open.empty()) {
    const KvfNode section = open.back();
    open.pop_back();
    Require(kvfIsSection(section) && kvfGetLine(section) > 0);
    for (const char* name : {"a", "SYMBOL", "ID", "true"}) ReadParameters(section, name);
    for (int number = 1; number <= kvfGetNoSections(section); ++number) {
      const KvfNode child = kvfSectionByNum(section, number);
      Require(kvfSectionByNameNum(section, kvfGetNameGlb(child), 1) != nullptr);
      open.push_back(child);
    }
  }
  kvfClose(&file);
  return 0;
}
