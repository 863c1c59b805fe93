// The tool cold: whole processes of it, a fresh one for each sample, over templates of growing size. With
// another build of the tool, both are run in turns and compared.
#include <CLI/CLI.hpp>
#include <algorithm>
#include <array>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <regex>
#include <stdexcept>

#include "allocation_count.h"
#include "generated_template.h"
#include "process_cost.h"
#include "samples.h"
#include "text_table.h"

namespace {

using namespace tessal::bench;

/// A command of the tool and the file that it writes, if any.
struct ToolCommand {
  std::string_view name;
  std::string_view output;
  bool replaces;  ///< only with --force
};

constexpr std::array kCommands = {
    ToolCommand{"check", {}, false},
    ToolCommand{"save", "saved.tessal", true},
    ToolCommand{"html", "page.html", false},
    ToolCommand{"overview", {}, false},
};

constexpr std::array<std::int64_t, 3> kSizes = {1'000, 10'000, 100'000};
constexpr std::int64_t kLargest = 1'000'000;

struct Options {
  std::string tool = TESSAL_TOOL;
  std::string other;  ///< another build, to compare with; empty for none
  std::string filter;
  int samples = 5;
  bool million = false;
};

/// A template of some size, in a file.
struct SizedFile {
  std::int64_t elements;
  std::string path;
};

std::vector<std::string> CommandLine(const std::string& tool, const ToolCommand& command,
                                     const SizedFile& file, const ScratchFolder& folder) {
  std::vector<std::string> words = {tool, std::string(command.name)};
  if (!command.output.empty()) {
    words.insert(words.end(), {"--output", folder.File(std::string(command.output))});
  }
  if (command.replaces) words.push_back("--force");
  words.push_back(file.path);
  return words;
}

AllocationCounts CountAllocations(const std::vector<std::string>& command, const ScratchFolder& folder) {
  const std::string path = folder.File("allocations");
  AllocationCounts counts;
  std::ofstream(path, std::ios::binary).write(reinterpret_cast<const char*>(&counts), sizeof counts);
  RunProcess(command, {.messages = {},
                       .environment = {{"LD_PRELOAD", TESSAL_ALLOCATION_COUNT}, {kAllocationFile, path}}});
  std::ifstream(path, std::ios::binary).read(reinterpret_cast<char*>(&counts), sizeof counts);
  if (counts.calls == 0) throw std::runtime_error("the allocations were not counted");
  return counts;
}

/// The runs of one build of the tool, summed up.
struct Figures {
  explicit Figures(const std::vector<ProcessCost>& costs)
      : milliseconds(1e3 * MedianOf(costs, &ProcessCost::seconds)),
        peakBytes(MedianOf(costs, &ProcessCost::peakBytes)),
        pageFaults(MedianOf(costs, &ProcessCost::pageFaults)) {}

  double milliseconds;
  double peakBytes;
  double pageFaults;
};

class ColdRuns final {
 public:
  explicit ColdRuns(Options chosen) : options(std::move(chosen)), filter(options.filter) {}

  /// Of the sizes that are wanted.
  void MakeFiles();
  bool HasFiles() const { return !files.empty(); }
  /// The figures of the tool, and how they grow from a size to ten times that size.
  void PrintFigures();
  /// The figures of the tool and of the other build, and their ratios.
  void PrintComparison();

 private:
  bool IsWanted(const ToolCommand& command, const SizedFile& file) const {
    return std::regex_search(NameOf(command, file), filter);
  }
  static std::string NameOf(const ToolCommand& command, const SizedFile& file) {
    return std::string(command.name) + "/" + std::to_string(file.elements);
  }
  Work<ProcessCost> Run(const std::string& tool, const ToolCommand& command, const SizedFile& file) const;
  /// Calls the print for each wanted command and size, the sizes of one command one after the other.
  template <class Print>
  void ForEachWanted(Print print);

  Options options;
  std::regex filter;
  ScratchFolder folder;
  std::vector<SizedFile> files;
};

void ColdRuns::MakeFiles() {
  std::vector<std::int64_t> sizes(kSizes.begin(), kSizes.end());
  if (options.million) sizes.push_back(kLargest);
  for (const std::int64_t size : sizes) {
    const SizedFile file = {size, folder.File(std::to_string(size) + ".tessal")};
    const auto isWanted = [&](const ToolCommand& command) { return IsWanted(command, file); };
    if (std::none_of(kCommands.begin(), kCommands.end(), isWanted)) continue;
    InOtherProcess([&] { std::filesystem::rename(FileOfSize(folder, size), file.path); });
    files.push_back(file);
  }
}

Work<ProcessCost> ColdRuns::Run(const std::string& tool, const ToolCommand& command,
                                const SizedFile& file) const {
  return [words = CommandLine(tool, command, file, folder)] { return RunProcess(words); };
}

template <class Print>
void ColdRuns::ForEachWanted(Print print) {
  for (const ToolCommand& command : kCommands) {
    for (const SizedFile& file : files) {
      if (IsWanted(command, file)) print(command, file);
    }
  }
}

void ColdRuns::PrintFigures() {
  const TextTable table(
      18, {"tool, cold", "ms", "peak KB", "B/element", "faults/el.", "allocs/el.", "asked B/el.", "growth"});
  std::string_view formerCommand;
  std::int64_t formerSize = 0;
  double formerTime = 0;
  ForEachWanted([&](const ToolCommand& command, const SizedFile& file) {
    const Figures figures(InTurns<ProcessCost>({Run(options.tool, command, file)}, options.samples).front());
    const AllocationCounts counts =
        CountAllocations(CommandLine(options.tool, command, file, folder), folder);
    const auto elements = static_cast<double>(file.elements);
    const bool grew = command.name == formerCommand && file.elements == 10 * formerSize;
    table.PrintRow({NameOf(command, file), ThreeDigits(figures.milliseconds),
                    Fixed(figures.peakBytes / 1024, 0), Fixed(figures.peakBytes / elements, 0),
                    ThreeDigits(figures.pageFaults / elements),
                    ThreeDigits(static_cast<double>(counts.calls) / elements),
                    Fixed(static_cast<double>(counts.bytes) / elements, 0),
                    grew ? ThreeDigits(figures.milliseconds / formerTime) : ""});
    formerCommand = command.name;
    formerSize = file.elements;
    formerTime = figures.milliseconds;
  });
}

void ColdRuns::PrintComparison() {
  const TextTable table(18, {"tool, cold", "ms now", "ms then", "now/then", "peak KB now", "then", "now/then",
                             "faults now", "then", "now/then"});
  ForEachWanted([&](const ToolCommand& command, const SizedFile& file) {
    const auto costs = InTurns<ProcessCost>(
        {Run(options.tool, command, file), Run(options.other, command, file)}, options.samples);
    const Figures now(costs[0]);
    const Figures then(costs[1]);
    table.PrintRow({NameOf(command, file), ThreeDigits(now.milliseconds), ThreeDigits(then.milliseconds),
                    Fixed(now.milliseconds / then.milliseconds, 2), Fixed(now.peakBytes / 1024, 0),
                    Fixed(then.peakBytes / 1024, 0), Fixed(now.peakBytes / then.peakBytes, 2),
                    Fixed(now.pageFaults, 0), Fixed(then.pageFaults, 0),
                    Fixed(now.pageFaults / then.pageFaults, 2)});
  });
}

}  // namespace

int main(int count, char** arguments) {
  Options options;
  CLI::App app("Runs whole processes of the tool and prints what they cost, as medians.");
  app.add_option("FILTER", options.filter, "a regular expression: which of check/1000 ... to run");
  app.add_option("--against", options.other, "another build of the tool, to compare with");
  app.add_option("--samples", options.samples, "how many processes for each figure")
      ->check(CLI::PositiveNumber);
  app.add_flag("--million", options.million, "1,000,000 elements too");
  CLI11_PARSE(app, count, arguments);
  return RunMain("cold_bench", [&options] {
    ColdRuns runs(options);
    runs.MakeFiles();
    if (!runs.HasFiles()) return;
    options.other.empty() ? runs.PrintFigures() : runs.PrintComparison();
  });
}
