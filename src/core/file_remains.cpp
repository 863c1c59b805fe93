#include "core/file_remains.h"

#include <string>
#include <string_view>
#include <unordered_map>

#include "core/template_state.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

std::string Shortened(std::string_view text) {
  std::string shortened(text.substr(0, kLongestShown));
  if (text.size() > kLongestShown) shortened += "...";
  return shortened;
}

/// What is left out, in the order of the file. A list of more than anybody reads ends in the number of those
/// that follow.
class LeftOut final {
 public:
  explicit LeftOut(LoadAccount& loadAccount) : account(loadAccount) {}

  void Note(std::string_view symbol, int line, const Finding& finding) {
    if (listed == kMostListed) {
      ++further;
      return;
    }
    ++listed;
    account.Note(AccountKind::Dropped, symbol, line, finding);
  }
  void Finish() {
    if (further == 0) return;
    account.Note(AccountKind::Dropped, "", 0, {"more-dropped", {std::to_string(further)}});
  }

 private:
  static constexpr std::size_t kMostListed = 100'000;

  LoadAccount& account;
  std::size_t listed = 0;
  std::size_t further = 0;
};

Finding FindingOf(const KvfUnread& unread, const std::string& parent) {
  switch (unread.what) {
    case KvfUnread::What::Section:
      return {"section-dropped", {Shortened(kvfGetNameGlb(unread.node)), parent}};
    case KvfUnread::What::Keyword:
      return {"keyword-dropped", {kvfGetSource(unread.node, kLongestShown), parent}};
    case KvfUnread::What::FurtherValues:
      break;
  }
  return {"values-dropped", {kvfGetSource(unread.node, kLongestShown), parent}};
}

void NoteUnread(KvfNode target, LoadAccount& account) {
  LeftOut list(account);
  kvfForEachUnread(target, [&list](const KvfUnread& unread) {
    const std::string parent = Shortened(kvfGetNameGlb(unread.parent));
    list.Note(parent, kvfGetLine(unread.node), FindingOf(unread, parent));
  });
  list.Finish();
}

/// Comments on lines that follow each other are one entry, under the first of them.
class CommentBlocks final {
 public:
  explicit CommentBlocks(LoadAccount& account) : list(account) {}

  void Add(const KvfRemark& remark) {
    if (count > 0 && remark.line == last + 1) {
      ++count;
    } else {
      EndBlock();
      first = remark;
      count = 1;
    }
    last = remark.line;
  }
  void Finish() {
    EndBlock();
    list.Finish();
  }

 private:
  void EndBlock() {
    if (count == 0) return;
    const std::string line = std::to_string(first.line);
    const std::string rest = count == 1
                                 ? " in line " + line
                                 : " and those after it, lines " + line + " to " + std::to_string(last) + ",";
    list.Note("", first.line, {"comment-dropped", {"'// " + Shortened(first.text) + "'" + rest}});
  }

  LeftOut list;
  KvfRemark first{};
  int count = 0;
  int last = 0;
};

void NoteComments(KvfHandle file, KvfNode target, LoadAccount& account) {
  CommentBlocks blocks(account);
  kvfForEachRemark(file, target, [&blocks](const KvfRemark& remark) { blocks.Add(remark); });
  blocks.Finish();
}

void NoteSharedSymbols(const TemplateState& state, LoadAccount& account) {
  if (!state.table.HasSharedSymbols()) return;
  std::unordered_map<std::string_view, int> uses;
  state.table.ForEachElement([&uses, &account](const SymbolRecord& record) {
    const CEL_Element& element = *record.element;
    // Movements have no symbol of their own.
    if (!element.symbol.Editable() || ++uses[element.symbol.Text()] != 2) return;
    account.Note(AccountKind::Absent, element.symbol.Text(), element.SourceLine(),
                 {"symbol-twice", {element.symbol.Text()}});
  });
}

/// A save writes the texts of another list head in the place of some.
void NoteTransientTexts(const TemplateState& state, LoadAccount& account) {
  ForEachHeadedCollection([&state, &account](const auto& row) {
    const CEL_Element& read = state.ListHead(row.listKind);
    const CEL_Element& written = state.ListHead(row.writtenHead);
    const auto isLost = [&read, &written](CEL_Property CEL_Element::*text) {
      return !(read.*text).Text().empty() && (read.*text).Text() != (written.*text).Text();
    };
    if (isLost(&CEL_Element::description) || isLost(&CEL_Element::onlineHelp) ||
        isLost(&CEL_Element::documentation)) {
      account.Note(AccountKind::Dropped, row.section, read.SourceLine(),
                   {"head-texts-dropped", {row.section, written.symbol.Text()}});
    }
  });
}

bool HasTexts(const CEL_Element& head) {
  return !head.description.Text().empty() || !head.onlineHelp.Text().empty() ||
         !head.documentation.Text().empty();
}

/// The lists of the settings are written with what they list alone.
void NoteTextsOfEmptyLists(CEL_Miscanellous& misc, LoadAccount& account) {
  const auto note = [&account](const CEL_Element& head, std::string_view section) {
    if (!HasTexts(head)) return;
    account.Note(AccountKind::Dropped, section, head.SourceLine(), {"empty-list-dropped", {section}});
  };
  if (misc.ExternalFunctions().empty()) note(misc.ExternalFunctionHead(), section::kExternalFunctions);
  const CEL_Visibility& visibilities = misc.Visibilities();
  if (visibilities.groups.empty() && visibilities.groupsPassedOver.empty()) {
    note(visibilities, section::kVisibilityGroups);
  }
}

}  // namespace

void NoteWhatNobodyRead(KvfHandle file, KvfNode target, TemplateState& state) {
  LoadAccount& account = state.account;
  if (target != nullptr) {
    NoteUnread(target, account);
    NoteSharedSymbols(state, account);
    NoteTransientTexts(state, account);
    if (state.hasMisc) NoteTextsOfEmptyLists(state.misc, account);
  }
  NoteComments(file, target, account);
  if (const std::size_t cut = kvfGetBytesCut(file); cut > 0) {
    account.Note(AccountKind::Dropped, "", 0, {"text-dropped", {std::to_string(cut)}});
  }
  account.SortByLine();
}

}  // namespace tessal
