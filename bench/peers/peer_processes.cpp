// Whole processes, a fresh one for each sample: the tool's check of a model beside the reading alone of the
// same model as SBML, and its check of an example beside a check of the same content as XML.
#include <filesystem>
#include <iostream>
#include <optional>
#include <stdexcept>
#include <string>

#include "content.h"
#include "generated_model.h"
#include "generated_template.h"
#include "keyfile/item_tree.h"
#include "platform/file_replacement.h"
#include "process_cost.h"
#include "ratio_table.h"
#include "samples.h"
#include "sbml_model.h"

namespace {

using namespace tessal;
using namespace tessal::bench;

void WriteFile(const std::string& path, const std::string& text) {
  if (const std::string failure = ReplaceFile(path, text); !failure.empty()) {
    throw std::runtime_error(failure);
  }
}

std::string SizeOf(const std::string& path) {
  return std::to_string(std::filesystem::file_size(path)) + " bytes";
}

void CompareModel(const RatioTable& table, int elements, int samples) {
  constexpr const char* kPeer = "libSBML, reading alone";
  const ScratchFolder folder;
  const std::string key = folder.File("model.tessal");
  const std::string sbml = folder.File("model.xml");
  InOtherProcess([&] {
    const GeneratedModel model(elements);
    WriteFile(key, TemplateText(model));
    WriteFile(sbml, SbmlText(model));
  });
  const auto costs = InTurns<ProcessCost>({[&] {
                                             return RunProcess({TESSAL_TOOL, "check", key});
                                           },
                                           [&] {
                                             return RunProcess({SBML_READER, sbml});
                                           }},
                                          samples);
  const auto print = [&](const char* unit, double ProcessCost::*part, double ourScale, double theirScale) {
    table.PrintRow("load and check " + std::to_string(elements) + " elements", kPeer, unit,
                   ourScale * MedianOf(costs[0], part), theirScale * MedianOf(costs[1], part));
  };
  const auto timesFile = [](const std::string& path) {
    return 1 / static_cast<double>(std::filesystem::file_size(path));
  };
  print("ms", &ProcessCost::seconds, 1e3, 1e3);
  print("peak B/element", &ProcessCost::peakBytes, 1.0 / elements, 1.0 / elements);
  print("peak/file", &ProcessCost::peakBytes, timesFile(key), timesFile(sbml));
  print("faults/element", &ProcessCost::pageFaults, 1.0 / elements, 1.0 / elements);
  std::cout << "  template " << SizeOf(key) << ", SBML " << SizeOf(sbml) << '\n';
}

/// The content of a key file as XML of the same size, filled up with blanks at its end. What is longer stays
/// as long as it is.
void WriteAsXml(const std::string& keyFile, const std::string& path) {
  std::string failure;
  const std::optional<std::string> text = ReadWholeFile(keyFile, failure);
  if (!text) throw std::runtime_error(failure);
  CKvfItemTree tree;
  ReadTree(*text, tree);
  std::string xml = ContentAsXml(tree);
  if (xml.size() < text->size()) xml.resize(text->size(), ' ');
  WriteFile(path, xml);
}

void CompareExample(const RatioTable& table) {
  constexpr int kSamples = 101;
  const ScratchFolder folder;
  const std::string xml = folder.File("example.xml");
  InOtherProcess([&] { WriteAsXml(TESSAL_EXAMPLE, xml); });
  const auto costs = InTurns<ProcessCost>({[] {
                                             return RunProcess({TESSAL_TOOL, "check", TESSAL_EXAMPLE});
                                           },
                                           [&] {
                                             return RunProcess({XMLLINT, "--noout", xml});
                                           }},
                                          kSamples);
  table.PrintRow("check of an example", "xmllint --noout", "ms",
                 1e3 * MedianOf(costs[0], &ProcessCost::seconds),
                 1e3 * MedianOf(costs[1], &ProcessCost::seconds));
  std::cout << "  template " << SizeOf(TESSAL_EXAMPLE) << ", XML " << SizeOf(xml) << '\n';
}

void Compare() {
  const RatioTable table;
  CompareModel(table, 10'000, 21);
  CompareModel(table, 100'000, 5);
  CompareExample(table);
}

}  // namespace

int main() {
  return RunMain("peer_processes", Compare);
}
