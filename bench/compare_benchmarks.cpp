// Two builds of the Google Benchmark programs, compared: each benchmark is run alone in a fresh process, the
// builds in turns, and the medians of the processor time are set against each other.
#include <CLI/CLI.hpp>
#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <map>
#include <nlohmann/json.hpp>
#include <regex>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include "process_cost.h"
#include "samples.h"
#include "scratch_folder.h"
#include "text_table.h"

namespace {

using namespace tessal::bench;

struct Options {
  std::string now;
  std::string then;
  std::string filter;
  int rounds = 5;
};

/// Runs a program whose report of the machine nobody asked for; what it wrote is part of a failure.
void RunQuietly(const std::vector<std::string>& command, const std::string& output,
                const ScratchFolder& folder) {
  const std::string path = folder.File("messages");
  try {
    RunProcess(command, {.output = output, .messages = path, .environment = {}});
  } catch (const std::runtime_error& failure) {
    std::ostringstream messages;
    messages << failure.what() << '\n' << std::ifstream(path).rdbuf();
    throw std::runtime_error(messages.str());
  }
}

/// The names of the benchmarks of a program.
std::vector<std::string> BenchmarksOf(const std::string& program, const ScratchFolder& folder) {
  const std::string path = folder.File("list");
  RunQuietly({program, "--benchmark_list_tests"}, path, folder);
  std::ifstream list(path);
  std::vector<std::string> names;
  for (std::string name; std::getline(list, name);) names.push_back(name);
  return names;
}

/// The programs of a build that are Google Benchmark's, by their file names.
std::vector<std::string> ProgramsIn(const std::string& build) {
  std::vector<std::string> names;
  for (const auto& entry : std::filesystem::directory_iterator(build)) {
    const std::string name = entry.path().filename().string();
    if (name.ends_with("_bench") && name != "cold_bench") names.push_back(name);
  }
  std::sort(names.begin(), names.end());
  return names;
}

/// A regular expression that only this text matches.
std::string Exactly(const std::string& text) {
  static const std::regex special(R"([.^$|()\\[\]{}*+?])");
  return "^" + std::regex_replace(text, special, R"(\$&)") + "$";
}

/// Nanoseconds of the processor for one turn of a benchmark.
double RunOnce(const std::string& program, const std::string& name, const ScratchFolder& folder) {
  constexpr const char* kLeastSeconds = "0.1";
  const std::string path = folder.File("result.json");
  RunQuietly({program, "--benchmark_filter=" + Exactly(name), "--benchmark_out=" + path,
              "--benchmark_out_format=json", std::string("--benchmark_min_time=") + kLeastSeconds},
             "/dev/null", folder);
  const nlohmann::json result = nlohmann::json::parse(std::ifstream(path));
  static const std::map<std::string, double> kNanoseconds = {{"ns", 1}, {"us", 1e3}, {"ms", 1e6}, {"s", 1e9}};
  for (const nlohmann::json& run : result.at("benchmarks")) {
    if (run.value("error_occurred", false)) {
      throw std::runtime_error(name + ": " + run.value("error_message", ""));
    }
    if (run.value("run_type", "iteration") != "iteration") continue;
    return run.at("cpu_time").get<double>() * kNanoseconds.at(run.at("time_unit").get<std::string>());
  }
  throw std::runtime_error(program + " gives no time of " + name);
}

void CompareProgram(const Options& options, const std::string& program, const TextTable& table,
                    const ScratchFolder& folder) {
  const std::string now = options.now + "/" + program;
  const std::string then = options.then + "/" + program;
  if (!std::filesystem::exists(then)) {
    std::cout << program << ": not there then, skipped\n";
    return;
  }
  const std::regex filter(options.filter);
  const std::vector<std::string> former = BenchmarksOf(then, folder);
  for (const std::string& name : BenchmarksOf(now, folder)) {
    if (!std::regex_search(name, filter)) continue;
    if (std::find(former.begin(), former.end(), name) == former.end()) {
      std::cout << name << ": not there then, skipped\n";
      continue;
    }
    const auto times = InTurns<double>(
        {[&] { return RunOnce(now, name, folder); }, [&] { return RunOnce(then, name, folder); }},
        options.rounds);
    const double nowMedian = Median(times[0]);
    const double thenMedian = Median(times[1]);
    constexpr double kMicrosecond = 1e3;
    table.PrintRow({name, ThreeDigits(nowMedian / kMicrosecond), ThreeDigits(thenMedian / kMicrosecond),
                    Fixed(nowMedian / thenMedian, 2)});
  }
}

void Compare(const Options& options) {
  constexpr std::size_t kNameWidth = 40;
  const ScratchFolder folder;
  const TextTable table(kNameWidth, {"one process, warm", "us now", "us then", "now/then"});
  for (const std::string& program : ProgramsIn(options.now)) {
    CompareProgram(options, program, table, folder);
  }
}

}  // namespace

int main(int count, char** arguments) {
  Options options;
  CLI::App app("Compares the benchmarks of two builds.");
  app.add_option("NOW", options.now, "the folder with the programs of one build")
      ->required()
      ->check(CLI::ExistingDirectory);
  app.add_option("THEN", options.then, "that of the other build")->required()->check(CLI::ExistingDirectory);
  app.add_option("FILTER", options.filter, "a regular expression: which benchmarks to run");
  app.add_option("--rounds", options.rounds, "how often to run each of them")->check(CLI::PositiveNumber);
  CLI11_PARSE(app, count, arguments);
  return RunMain("compare_benchmarks", [&options] { Compare(options); });
}
