// A read of a key file that builds its item tree. The texts and items under construction lie in stores here,
// whose places are the values of the grammar, so that a failed read releases everything.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "keyfile/item_tree.h"
#include "keyfile/read_state.h"

namespace tessal {

/// Things that are put in, and taken out again soon after. A place is used again when it is free.
template <class Thing>
class PlaceStore final {
 public:
  std::uint32_t Put(Thing thing) {
    if (free.empty()) {
      things.push_back(std::move(thing));
      return static_cast<std::uint32_t>(things.size() - 1);
    }
    const std::uint32_t place = free.back();
    free.pop_back();
    things[place] = std::move(thing);
    return place;
  }
  Thing& At(std::uint32_t place) { return things[place]; }
  Thing Take(std::uint32_t place) {
    free.push_back(place);
    return std::move(things[place]);
  }

 private:
  std::vector<Thing> things;
  std::vector<std::uint32_t> free;
};

class TreeBuilder final : public ReadState {
 public:
  /// A tree may take so many times the bytes of its text, and something for a small text of short lines.
  static constexpr std::size_t kMostTimes = 12;
  static constexpr std::size_t kFreeBytes = 256'000'000;

  explicit TreeBuilder(std::string& scanned) : ReadState(scanned) {}

  std::uint32_t NewComment(std::uint32_t line) override;
  std::uint32_t PrependComment(std::uint32_t line, std::uint32_t block) override;
  std::uint32_t NewTargets(std::uint32_t section) override;
  std::uint32_t PrependTarget(std::uint32_t section, std::uint32_t targets) override;
  std::uint32_t NewSection() override;
  std::uint32_t AppendItem(std::uint32_t section, std::uint32_t item) override;
  std::uint32_t EndSection(std::uint32_t section, std::uint32_t name, std::uint32_t startComment,
                           std::uint32_t endComment) override;
  std::uint32_t RealValue(std::uint32_t digits) override;
  std::uint32_t IntegerValue(std::uint32_t digits) override;
  std::uint32_t BooleanValue(std::uint32_t word) override;
  std::uint32_t QuotedValue(std::uint32_t content) override;
  std::uint32_t PathValue(std::uint32_t content) override;
  std::uint32_t NewKey(std::uint32_t value) override;
  std::uint32_t AppendValue(std::uint32_t key, std::uint32_t value) override;
  std::uint32_t EndKey(std::uint32_t key, std::uint32_t name, std::uint32_t comment) override;
  void Finish(std::uint32_t header, std::uint32_t targets) override;
  bool IsFull() const override { return spent > kFreeBytes + kMostTimes * TextSize(); }

  /// The finished tree; none after a failure.
  std::unique_ptr<CKvfSectionItem>& Root() { return root; }

 private:
  std::uint32_t Keep(std::string_view token) override { return texts.Put(std::string(token)); }
  void BeginLiteral() override { literal.clear(); }
  void AppendLiteral(std::string_view piece) override { literal += piece; }
  std::uint32_t KeepLiteral() override;

  std::string TextAt(std::uint32_t place) { return place == kNothing ? std::string() : texts.Take(place); }
  template <class Item>
  std::uint32_t PutNew(std::unique_ptr<Item> item) {
    spent += sizeof(Item) + kBlock;
    return items.Put(std::move(item));
  }
  std::uint32_t PutValue(KvfValue value) {
    spent += sizeof(KvfValue) + kBlock;
    return values.Put(std::move(value));
  }

  CKvfSectionItem& SectionAt(std::uint32_t place) { return static_cast<CKvfSectionItem&>(*items.At(place)); }
  CKvfKeyItem& KeyAt(std::uint32_t place) { return static_cast<CKvfKeyItem&>(*items.At(place)); }

  /// What a block of memory and the pointer to it take beside its content.
  static constexpr std::size_t kBlock = 24;

  std::size_t spent = 0;  ///< bytes, but for those of long texts, which the text has too
  std::string literal;
  PlaceStore<std::string> texts;
  PlaceStore<KvfValue> values;
  PlaceStore<std::unique_ptr<CKvfBaseItem>> items;
  std::vector<std::unique_ptr<CKvfBaseItem>> targetsBackwards;
  std::unique_ptr<CKvfSectionItem> root;
};

}  // namespace tessal
