// A save of a template, beside writing the same bytes to a file in one go.
#include <fcntl.h>

#include <chrono>
#include <stdexcept>
#include <string>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "generated_template.h"
#include "platform/descriptor.h"
#include "platform/file_replacement.h"
#include "process_cost.h"
#include "ratio_table.h"
#include "samples.h"

namespace {

using namespace tessal;
using namespace tessal::bench;

constexpr int kElements = 10'000;
constexpr int kRounds = 31;

/// In seconds: of the processor, and until the work was done, which has the disk's part too.
struct SaveCost {
  double processor;
  double elapsed;
};

template <class Save>
Work<SaveCost> Timed(Save save) {
  return [save] {
    using Clock = std::chrono::steady_clock;
    const ProcessorClock processor;
    const auto start = Clock::now();
    save();
    const std::chrono::duration<double> elapsed = Clock::now() - start;
    return SaveCost{processor.Seconds(), elapsed.count()};
  };
}

void Require(bool isDone) {
  if (!isDone) throw std::runtime_error("the bytes can not be written");
}

void Flush(const std::string& path, int flags) {
  const Descriptor opened(open(path.c_str(), flags | O_CLOEXEC));
  Require(opened.IsOpen() && fsync(opened.Number()) == 0);
}

void WriteBytes(const std::string& path, std::string_view bytes) {
  Descriptor file(open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0666));
  Require(file.IsOpen() && WriteAll(file.Number(), bytes) && file.Close());
}

void Compare() {
  const ScratchFolder folder;
  const std::string path = FileOfSize(folder, kElements);
  const std::string copy = folder.File("copy");
  TemplateCore core;
  const auto save = [&core, &path] {
    if (!core.SaveWrapper(path)) throw std::runtime_error(Errors().JoinErrors());
  };
  if (!core.LoadWrapper(path)) throw std::runtime_error(Errors().JoinErrors());
  save();
  std::string failure;
  const std::string bytes = ReadWholeFile(path, failure).value();
  const auto costs = InTurns<SaveCost>({Timed(save), Timed([&] {
                                          WriteBytes(copy, bytes);
                                          Flush(copy, O_RDWR);
                                          Flush(folder.File(""), O_RDONLY | O_DIRECTORY);
                                        }),
                                        Timed([&] { WriteBytes(copy, bytes); })},
                                       kRounds);
  const RatioTable table;
  const auto print = [&](const char* unit, double SaveCost::*part) {
    constexpr const char* kPeers[] = {"write, fsync of file and folder", "write"};
    for (std::size_t peer = 1; peer < costs.size(); ++peer) {
      table.PrintRow("save of " + std::to_string(kElements) + " elements", kPeers[peer - 1], unit,
                     1e3 * MedianOf(costs[0], part), 1e3 * MedianOf(costs[peer], part));
    }
  };
  print("ms of processor", &SaveCost::processor);
  print("ms elapsed", &SaveCost::elapsed);
}

}  // namespace

int main() {
  return RunMain("peer_save", Compare);
}
