#include "core/file_remains.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "core/template_state.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

constexpr std::size_t kLongestShown = 200;

std::string Shortened(const std::string& text) {
  return text.size() <= kLongestShown ? text : text.substr(0, kLongestShown) + "...";
}

void NoteUnread(const KvfUnread& unread, LoadAccount& account) {
  const std::string parent = kvfGetNameGlb(unread.parent);
  const int line = kvfGetLine(unread.node);
  switch (unread.what) {
    case KvfUnread::What::Section:
      account.Note(AccountKind::Dropped, parent, line,
                   {"section-dropped", {kvfGetNameGlb(unread.node), parent}});
      break;
    case KvfUnread::What::Keyword:
      account.Note(AccountKind::Dropped, parent, line,
                   {"keyword-dropped", {Shortened(kvfGetSource(unread.node)), parent}});
      break;
    case KvfUnread::What::FurtherValues:
      account.Note(AccountKind::Dropped, parent, line,
                   {"values-dropped", {Shortened(kvfGetSource(unread.node)), parent}});
      break;
  }
}

/// Comments on lines that follow each other are one entry, under the first of them.
void NoteComments(const std::vector<KvfRemark>& remarks, LoadAccount& account) {
  for (std::size_t first = 0; first < remarks.size();) {
    std::size_t next = first + 1;
    while (next < remarks.size() && remarks[next].line == remarks[next - 1].line + 1) ++next;
    std::string shown = "'// " + Shortened(remarks[first].text) + "'";
    const std::string line = std::to_string(remarks[first].line);
    const std::string last = std::to_string(remarks[next - 1].line);
    shown +=
        next - first == 1 ? " in line " + line : " and those after it, lines " + line + " to " + last + ",";
    account.Note(AccountKind::Dropped, "", remarks[first].line, {"comment-dropped", {shown}});
    first = next;
  }
}

void NoteSharedSymbols(const TemplateState& state, LoadAccount& account) {
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
    for (const KvfUnread& unread : kvfGetUnread(target)) NoteUnread(unread, account);
    NoteSharedSymbols(state, account);
    NoteTransientTexts(state, account);
    if (state.hasMisc) NoteTextsOfEmptyLists(state.misc, account);
  }
  NoteComments(kvfGetRemarks(file, target), account);
  if (const std::size_t cut = kvfGetBytesCut(file); cut > 0) {
    account.Note(AccountKind::Dropped, "", 0, {"text-dropped", {std::to_string(cut)}});
  }
  account.SortByLine();
}

}  // namespace tessal
