// The check of units beside that of libSBML, on the same templates: how many slips in units each of the two
// finds. With `--list`, the slips that only one of them finds.
#include <sbml/SBMLTypes.h>

#include <algorithm>
#include <cstdint>
#include <fstream>
#include <iostream>
#include <iterator>
#include <map>
#include <memory>
#include <set>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "analysis/unit_check.h"
#include "core/template_core.h"
#include "process_cost.h"
#include "scratch_folder.h"
#include "template_sbml.h"
#include "text_table.h"
#include "unit_slips.h"

namespace {

using namespace tessal;
using namespace tessal::bench;

constexpr const char* kExamples[] = {"streeter_phelps", "fasham", "eutrophication", "asm1",
                                     "lake_management"};

/// What is wrong with which elements: the number of a record, and a code.
using Findings = std::multiset<std::pair<std::uint32_t, std::string>>;

struct Verdicts {
  Findings ours;
  Findings theirs;
  std::size_t rules = 0;
  std::vector<std::string> leftOut;
};

/// What libSBML says of rules whose units are not all declared is no finding.
bool IsFinding(const SBMLError& error) {
  return error.getCategory() == LIBSBML_CAT_UNITS_CONSISTENCY && error.getErrorId() != UndeclaredUnits &&
         error.getErrorId() != UndeclaredTimeUnitsL3 && error.getErrorId() != UndeclaredExtentUnitsL3 &&
         error.getErrorId() != UndeclaredObjectUnitsL3;
}

/// The numbers of the records by the lines at which their rules begin.
std::map<unsigned, std::uint32_t> LinesOfRules(const Model& model, const TemplateSbml& sbml) {
  std::map<unsigned, std::uint32_t> lines;
  for (unsigned place = 0; place < model.getNumRules(); ++place) {
    const Rule& rule = *model.getRule(place);
    lines[rule.getLine()] = sbml.sequences.at(rule.getVariable());
  }
  return lines;
}

Findings TheirFindings(const TemplateSbml& sbml) {
  const std::unique_ptr<SBMLDocument> document(readSBMLFromString(sbml.text.c_str()));
  if (document->getNumErrors() > 0) {
    document->printErrors(std::cerr);
    throw std::runtime_error("libSBML does not read the template");
  }
  for (unsigned category = LIBSBML_CAT_GENERAL_CONSISTENCY; category <= LIBSBML_CAT_MODELING_PRACTICE;
       ++category) {
    document->setConsistencyChecks(static_cast<SBMLErrorCategory_t>(category),
                                   category == LIBSBML_CAT_UNITS_CONSISTENCY);
  }
  document->checkConsistency();
  const std::map<unsigned, std::uint32_t> elements = LinesOfRules(*document->getModel(), sbml);
  Findings findings;
  for (unsigned place = 0; place < document->getNumErrors(); ++place) {
    const SBMLError& error = *document->getError(place);
    if (!IsFinding(error)) continue;
    // The rule that the line is in.
    auto rule = elements.upper_bound(error.getLine());
    if (rule != elements.begin()) --rule;
    findings.emplace(rule->second, std::to_string(error.getErrorId()));
  }
  return findings;
}

Findings OurFindings(const TemplateCore& core) {
  Findings findings;
  for (const UnitFinding& each : CheckUnits(core, Substances::Ignored).findings) {
    const SymbolRecord* record = core.FindRecordByUid(each.finding.element);
    // Those of particle classes have no counterpart.
    if (record != nullptr && record->specieIndex < 0) {
      findings.emplace(record->sequence, each.finding.message->code);
    }
  }
  return findings;
}

Verdicts Judge(const std::string& path) {
  TemplateCore core;
  if (!core.LoadWrapper(path)) throw std::runtime_error("a slip can not be loaded from " + path);
  const TemplateSbml sbml = ToSbml(core);
  return {OurFindings(core), TheirFindings(sbml), sbml.sequences.size(), sbml.leftOut};
}

std::string FileText(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  if (!file) throw std::runtime_error("can not read " + path);
  return {std::istreambuf_iterator<char>(file), {}};
}

bool HasNew(const Findings& findings, const Findings& before) {
  return !std::includes(before.begin(), before.end(), findings.begin(), findings.end());
}

struct Counts {
  std::size_t slips = 0;
  std::size_t ours = 0;
  std::size_t theirs = 0;
  std::size_t both = 0;
};

void PrintCounts(const TextTable& table, const std::string& what, const Counts& counts) {
  table.PrintRow({what, std::to_string(counts.slips), std::to_string(counts.ours),
                  std::to_string(counts.theirs), std::to_string(counts.both),
                  std::to_string(counts.ours - counts.both), std::to_string(counts.theirs - counts.both)});
}

class Comparison final {
 public:
  explicit Comparison(bool listsAll)
      : isListing(listsAll),
        table(44, {"", "slips", "ours", "libSBML", "both", "only ours", "only libSBML"}) {}

  void Compare(const std::string& name) {
    const std::string path = std::string(TESSAL_EXAMPLES) + "/" + name + ".tessal";
    const std::string text = FileText(path);
    const Verdicts before = Judge(path);
    notes.push_back(name + ": " + std::to_string(before.rules) + " expressions, " +
                    std::to_string(before.leftOut.size()) + " left out; findings without a slip: ours " +
                    std::to_string(before.ours.size()) + ", libSBML " + std::to_string(before.theirs.size()));
    Count(name + ", unit of another dimension", UnitsOfOtherDimensions(text), before);
    Count(name + ", unit of another size", UnitsOfOtherSizes(text), before);
    Count(name + ", factor left out", FactorsLeftOut(path, text), before);
  }

  void PrintRest() const {
    PrintCounts(table, "all", all);
    std::cout << "\n";
    for (const std::string& note : notes) std::cout << note << "\n";
  }

 private:
  std::string Written(const std::string& text) const {
    std::ofstream(scratch.File("slip.tessal"), std::ios::binary) << text;
    return scratch.File("slip.tessal");
  }

  void Count(const std::string& what, const std::vector<UnitSlip>& slips, const Verdicts& before) {
    Counts counts;
    for (const UnitSlip& slip : slips) {
      const Verdicts after = Judge(Written(slip.text));
      const bool ours = HasNew(after.ours, before.ours);
      const bool theirs = HasNew(after.theirs, before.theirs);
      for (Counts* sum : {&counts, &all}) {
        ++sum->slips;
        sum->ours += ours ? 1 : 0;
        sum->theirs += theirs ? 1 : 0;
        sum->both += ours && theirs ? 1 : 0;
      }
      if (isListing && ours != theirs)
        notes.push_back(what + ", " + slip.what + (ours ? ": only ours" : ": only libSBML"));
    }
    PrintCounts(table, what, counts);
  }

  bool isListing;
  TextTable table;
  ScratchFolder scratch;
  Counts all;
  std::vector<std::string> notes;
};

}  // namespace

int main(int count, char** arguments) {
  return RunMain("peer_units", [&] {
    Comparison comparison(count > 1 && std::string_view(arguments[1]) == "--list");
    for (const char* name : kExamples) comparison.Compare(name);
    comparison.PrintRest();
  });
}
