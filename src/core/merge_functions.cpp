#include "core/merge_functions.h"

#include <algorithm>
#include <map>
#include <memory>
#include <string>
#include <unordered_map>
#include <utility>

#include "core/list_order.h"

namespace tessal {

namespace {

using Functions = Sequence<CEL_ExternalFunction>;

/// The names of the functions of a list, each with its number among those of its name.
std::vector<std::string> KeysOf(const Functions& functions) {
  std::map<std::string, int> counts;
  std::vector<std::string> keys;
  for (const auto& function : functions) {
    const std::string name = function->publicName.TextOf();
    keys.push_back(name + '\n' + std::to_string(++counts[name]));
  }
  return keys;
}

class FunctionMerge final {
 public:
  FunctionMerge(CEL_Miscanellous& oursSettings, const CEL_Miscanellous& base, const CEL_Miscanellous& theirs,
                const ValueMerge& valueMerge, std::vector<MergeConflict>& conflictList)
      : settings(oursSettings), values(valueMerge), conflicts(conflictList) {
    List(base.ExternalFunctions(), inBase, baseOrder);
    List(settings.ExternalFunctions(), inOurs, ourOrder);
    List(theirs.ExternalFunctions(), inTheirs, theirOrder);
  }

  void Run() {
    for (const std::size_t number : ourOrder) MergeOurs(number);
    for (const std::size_t number : theirOrder) {
      if (!inOurs.contains(number)) MergeTheirs(number);
    }
    const auto isGone = [this](std::size_t number) { return !inOurs.contains(number); };
    std::erase_if(ourOrder, isGone);
    std::erase_if(baseOrder, [this](std::size_t number) {
      return !inOurs.contains(number) || !inTheirs.contains(number);
    });
    std::erase_if(theirOrder,
                  [this, &isGone](std::size_t number) { return isGone(number) && !coming.contains(number); });
    SetOrder(MergeOrders(baseOrder, ourOrder, theirOrder));
  }

 private:
  using ByNumber = std::unordered_map<std::size_t, CEL_ExternalFunction*>;

  void List(const Functions& functions, ByNumber& byNumber, ListOrder& order) {
    const std::vector<std::string> keys = KeysOf(functions);
    for (std::size_t place = 0; place < keys.size(); ++place) {
      const std::size_t number = numbers.emplace(keys[place], numbers.size()).first->second;
      byNumber.emplace(number, functions[place].get());
      order.push_back(number);
    }
  }

  static CEL_ExternalFunction* In(const ByNumber& functions, std::size_t number) {
    const auto hit = functions.find(number);
    return hit == functions.end() ? nullptr : hit->second;
  }

  void MergeOurs(std::size_t number) {
    CEL_ExternalFunction& our = *inOurs.at(number);
    const CEL_ExternalFunction* former = In(inBase, number);
    const CEL_ExternalFunction* their = In(inTheirs, number);
    const std::string name = our.publicName.TextOf();
    if (their != nullptr) {
      values.Merge(former, our, *their, name, noLinks);
      if (former != nullptr && former->symbol.Text() == our.symbol.Text())
        our.symbol.SetText(their->symbol.Text());
    } else if (former != nullptr && values.WeChanged(*former, our)) {
      conflicts.push_back(
          {std::string(our.KindText()), name, "", std::string(kKeptValue), std::string(kRemovedValue)});
    } else if (former != nullptr) {
      Remove(our);
      inOurs.erase(number);
    }
  }

  void Remove(const CEL_ExternalFunction& function) {
    const auto& functions = settings.ExternalFunctions();
    const auto place = std::find_if(functions.begin(), functions.end(),
                                    [&function](const auto& each) { return each.get() == &function; });
    settings.RemoveExternalFunction(static_cast<std::size_t>(place - functions.begin()));
  }

  void MergeTheirs(std::size_t number) {
    const CEL_ExternalFunction& their = *inTheirs.at(number);
    const CEL_ExternalFunction* former = In(inBase, number);
    if (former == nullptr) {
      CEL_ExternalFunction& made = settings.AddExternalFunction();
      values.Take(made, their, noLinks);
      made.symbol.SetText(their.symbol.Text());
      coming.emplace(number, &made);
    } else if (values.TheyChanged(*former, their)) {
      values.NoteTheirs(former, their, their.publicName.TextOf(), kRemovedValue);
    }
  }

  void SetOrder(const MergedOrder& merged) {
    Functions& functions = settings.ExternalFunctionList();
    std::unordered_map<const CEL_ExternalFunction*, std::unique_ptr<CEL_ExternalFunction>> owned;
    for (auto& function : functions) {
      const CEL_ExternalFunction* key = function.get();
      owned.emplace(key, std::move(function));
    }
    functions.clear();
    for (const std::size_t number : merged.order) {
      const CEL_ExternalFunction* ours = In(inOurs, number);
      functions.push_back(std::move(owned.at(ours == nullptr ? coming.at(number) : ours)));
    }
    for (const std::size_t number : merged.conflicts) {
      const CEL_ExternalFunction& moved = *inOurs.at(number);
      conflicts.push_back({std::string(moved.KindText()), moved.publicName.TextOf(), "Comes after",
                           std::string(kKeptValue), "moved"});
    }
  }

  CEL_Miscanellous& settings;
  const ValueMerge& values;
  std::vector<MergeConflict>& conflicts;
  std::map<std::string, std::size_t> numbers;
  ByNumber inBase;
  ByNumber inOurs;
  ByNumber inTheirs;
  ByNumber coming;  ///< what was made for theirs
  ListOrder baseOrder;
  ListOrder ourOrder;
  ListOrder theirOrder;
  LinksToSet noLinks;
};

}  // namespace

void MergeFunctions(CEL_Miscanellous& ours, const CEL_Miscanellous& base, const CEL_Miscanellous& theirs,
                    const ValueMerge& values, std::vector<MergeConflict>& conflicts) {
  const NotificationsOff silent;
  LinksToSet noLinks;
  values.Merge(&base.ExternalFunctionHead(), ours.ExternalFunctionHead(), theirs.ExternalFunctionHead(), "",
               noLinks);
  FunctionMerge(ours, base, theirs, values, conflicts).Run();
}

}  // namespace tessal
