// The `main` of the benchmarks. After the usual report it prints how the time of each benchmark grows for ten
// times the size, which only sizes that are measured in the same state, warm, can say.
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <charconv>
#include <cstdint>
#include <iomanip>
#include <iostream>
#include <map>
#include <optional>
#include <string>

namespace {

/// The size that a benchmark was run with; nothing when it has no single number as its argument.
std::optional<std::int64_t> SizeOf(const benchmark::BenchmarkName& name) {
  std::int64_t size = 0;
  const char* end = name.args.data() + name.args.size();
  const auto [rest, error] = std::from_chars(name.args.data(), end, size);
  if (error != std::errc() || rest != end) return std::nullopt;
  return size;
}

class GrowthReporter final : public benchmark::ConsoleReporter {
 public:
  explicit GrowthReporter(OutputOptions look) : ConsoleReporter(look) {}

  void ReportRuns(const std::vector<Run>& runs) override {
    ConsoleReporter::ReportRuns(runs);
    for (const Run& run : runs) {
      const std::optional<std::int64_t> size = SizeOf(run.run_name);
      if (size && run.run_type == Run::RT_Iteration && !run.error_occurred) {
        times[run.run_name.function_name][*size] = run.GetAdjustedCPUTime();
      }
    }
  }

  void Finalize() override {
    constexpr std::int64_t kTimes = 10;
    for (const auto& [name, sizes] : times) {
      for (const auto& [size, time] : sizes) {
        const auto larger = sizes.find(size * kTimes);
        if (larger == sizes.end()) continue;
        std::cout << name << ", " << size << " to " << larger->first << ": " << std::fixed
                  << std::setprecision(1) << larger->second / time << " times the processor time\n";
      }
    }
  }

 private:
  std::map<std::string, std::map<std::int64_t, double>> times;
};

}  // namespace

int main(int count, char** arguments) {
  benchmark::Initialize(&count, arguments);
  if (benchmark::ReportUnrecognizedArguments(count, arguments)) return 1;
  GrowthReporter reporter(isatty(STDOUT_FILENO) != 0 ? GrowthReporter::OO_Color : GrowthReporter::OO_None);
  benchmark::RunSpecifiedBenchmarks(&reporter);
  benchmark::Shutdown();
  return 0;
}
