#include "core/merge_kept_text.h"

#include <algorithm>
#include <map>
#include <optional>
#include <set>
#include <sstream>
#include <string>
#include <utility>

#include "core/template_core.h"
#include "keyfile/item_tree.h"
#include "keyfile/reader.h"
#include "platform/ascii.h"
#include "platform/kvf2004.h"

namespace tessal {

namespace {

constexpr std::string_view kPoolKind = "Pool";
constexpr std::string_view kSectionKind = "Further section";
constexpr std::string_view kTextField = "Text";
constexpr std::string_view kPoolsSection = "TESSAL_POOLS";

/// Sections by their names, as text.
using Sections = std::map<std::string, std::string>;

/// Nothing where a name occurs twice, or the text is none of sections.
std::optional<Sections> SectionsOf(const std::string& keptText) {
  Sections sections;
  if (keptText.empty()) return sections;
  CKvfItemTree tree;
  // A file of the format begins with a comment.
  if (ParseKeyFileTree("// \r\n\r\n" + keptText + "\r\n", tree) == 0) return std::nullopt;
  for (const CKvfBaseItem& child : tree.Children()) {
    if (child.ItemKind() != CKvfBaseItem::kSection) continue;
    std::string text;
    child.AppendTo(text);
    if (!sections.emplace(std::string(child.Name()), std::move(text)).second) return std::nullopt;
  }
  return sections;
}

std::string Without(const std::string& keptText, const std::string& section) {
  KvfHandle file = kvfLoadText(keptText);
  std::string rest = kvfTextBeside(file, kvfTargetByNameNum(file, section, 1));
  kvfClose(&file);
  return rest;
}

/// The lines of a text that hold nothing but a comment.
std::vector<std::string> CommentsOf(const std::string& text) {
  std::vector<std::string> comments;
  std::istringstream lines(text);
  for (std::string line; std::getline(lines, line);) {
    const auto begin = line.find_first_not_of(" \t");
    if (begin == std::string::npos || line.compare(begin, 2, "//") != 0) continue;
    if (line.back() == '\r') line.pop_back();
    comments.push_back(line.substr(begin));
  }
  return comments;
}

/// Whether pools are all that the section holds, so that they can be merged by their fields.
bool HasPlainPools(const TemplateCore& core) {
  const PoolsRead read = PoolsOf(core);
  std::set<std::string> names;
  for (const Pool& pool : read.pools) names.insert(pool.name);
  return read.faults.empty() && read.notPools.empty() && names.size() == read.pools.size();
}

const Pool* Named(const std::vector<Pool>& pools, const std::string& name) {
  const auto hit =
      std::find_if(pools.begin(), pools.end(), [&name](const Pool& each) { return each.name == name; });
  return hit == pools.end() ? nullptr : &*hit;
}

std::string Joined(const std::vector<std::string>& names) {
  std::string text;
  for (const std::string& name : names) text += (text.empty() ? "" : ", ") + name;
  return text;
}

class KeptTextMerge final {
 public:
  KeptTextMerge(TemplateCore& oursCore, const MergeSide& baseSide, const MergeSide& theirSide,
                std::vector<MergeConflict>& conflictList)
      : ours(oursCore), base(baseSide), theirs(theirSide), conflicts(conflictList) {}

  void Run() {
    const std::string& their = theirs.core.KeptText();
    const std::string& before = base.core.KeptText();
    if (their == before || their == ours.KeptText()) return;
    const std::vector<Pool> theirPools = PoolsUnderNames(theirs.core, theirs.names);
    if (ours.KeptText() == before && theirPools == PoolsOf(theirs.core).pools) {
      ours.SetKeptText(their);
      return;
    }
    mergesPools = HasPlainPools(ours) && HasPlainPools(base.core) && HasPlainPools(theirs.core);
    const std::vector<Pool> ourPools = PoolsOf(ours).pools;
    MergeSections();
    if (mergesPools) MergePools(PoolsUnderNames(base.core, base.names), ourPools, theirPools);
    NoteLostComments();
  }

 private:
  void Note(std::string_view kind, const std::string& name, std::string_view field, std::string our,
            std::string their) {
    conflicts.push_back({std::string(kind), name, std::string(field), std::move(our), std::move(their)});
  }

  void MergeSections() {
    const auto before = SectionsOf(base.core.KeptText());
    const auto our = SectionsOf(ours.KeptText());
    const auto their = SectionsOf(theirs.core.KeptText());
    if (!before || !our || !their) {
      mergesPools = false;
      Note(kSectionKind, "", kTextField, ours.KeptText(), theirs.core.KeptText());
      return;
    }
    std::set<std::string> names;
    for (const auto* sections : {&*before, &*our, &*their}) {
      for (const auto& [name, text] : *sections) names.insert(name);
    }
    const auto textIn = [](const Sections& sections, const std::string& name) {
      const auto hit = sections.find(name);
      return hit == sections.end() ? std::string() : hit->second;
    };
    for (const std::string& name : names) {
      if (mergesPools && EqualIgnoringCase(name, kPoolsSection)) continue;
      const std::string our1 = textIn(*our, name);
      const std::string their1 = textIn(*their, name);
      const MergedText merged = MergeTexts(textIn(*before, name), our1, their1);
      if (merged.isConflict) Note(kSectionKind, name, kTextField, our1, their1);
      if (merged.text != our1) Put(name, merged.text);
    }
  }

  void Put(const std::string& name, std::string text) {
    std::string kept = Without(ours.KeptText(), name);
    while (!text.empty() && (text.back() == '\n' || text.back() == '\r')) text.pop_back();
    if (!text.empty()) kept += (kept.empty() ? "" : "\r\n\r\n") + text;
    ours.SetKeptText(std::move(kept));
  }

  void MergePools(const std::vector<Pool>& before, const std::vector<Pool>& our,
                  const std::vector<Pool>& their) {
    std::vector<Pool> merged;
    for (const Pool& pool : our) {
      const Pool* former = Named(before, pool.name);
      const Pool* other = Named(their, pool.name);
      if (other != nullptr) {
        merged.push_back(MergePool(former, pool, *other));
      } else if (former == nullptr || *former != pool) {
        if (former != nullptr)
          Note(kPoolKind, pool.name, "", std::string(kKeptValue), std::string(kRemovedValue));
        merged.push_back(pool);
      }
    }
    for (const Pool& pool : their) {
      const Pool* former = Named(before, pool.name);
      if (Named(our, pool.name) != nullptr) continue;
      if (former == nullptr) {
        merged.push_back(pool);
      } else if (*former != pool) {
        Note(kPoolKind, pool.name, "Expression", std::string(kRemovedValue), pool.expression);
      }
    }
    std::string failure;
    if (merged != our && !SetPools(ours, merged, failure))
      Note(kPoolKind, "", "", std::string(kKeptValue), failure);
  }

  Pool MergePool(const Pool* former, const Pool& our, const Pool& their) {
    Pool merged = our;
    const auto merge = [this, former, &our](std::string_view field, const std::string& before,
                                            const std::string& ourText, const std::string& theirText) {
      MergedText text = MergeTexts(before, ourText, theirText);
      if (former == nullptr) text = {ourText, ourText != theirText};
      if (text.isConflict) Note(kPoolKind, our.name, field, ourText, theirText);
      return text.text;
    };
    const Pool nothing;
    const Pool& before = former == nullptr ? nothing : *former;
    merged.expression = merge("Expression", before.expression, our.expression, their.expression);
    merged.description = merge("Description", before.description, our.description, their.description);
    const std::string boundary =
        merge("Boundary", Joined(before.boundary), Joined(our.boundary), Joined(their.boundary));
    if (boundary == Joined(their.boundary)) merged.boundary = their.boundary;
    return merged;
  }

  /// Comments have no name by which they could be merged.
  void NoteLostComments() {
    std::set<std::string> known;
    for (const std::string* text : {&base.core.KeptText(), &ours.KeptText()}) {
      for (std::string& comment : CommentsOf(*text)) known.insert(std::move(comment));
    }
    for (const std::string& comment : CommentsOf(theirs.core.KeptText())) {
      if (known.insert(comment).second) Note("Comment", "", "", std::string(kRemovedValue), comment);
    }
  }

  TemplateCore& ours;
  const MergeSide& base;
  const MergeSide& theirs;
  std::vector<MergeConflict>& conflicts;
  bool mergesPools = false;
};

}  // namespace

std::vector<Pool> PoolsUnderNames(const TemplateCore& core, const NewNames& newNames) {
  std::vector<Pool> pools = PoolsOf(core).pools;
  for (Pool& pool : pools) {
    pool.expression = ReplaceNames(pool.expression, newNames);
    for (std::string& process : pool.boundary) {
      const auto hit = newNames.find(process);
      if (hit != newNames.end()) process = hit->second;
    }
  }
  return pools;
}

void MergeKeptText(TemplateCore& ours, const MergeSide& base, const MergeSide& theirs,
                   std::vector<MergeConflict>& conflicts) {
  KeptTextMerge(ours, base, theirs, conflicts).Run();
}

}  // namespace tessal
