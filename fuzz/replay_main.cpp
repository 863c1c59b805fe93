// Runs every file of the folders given through a fuzz target, and the empty input too: what the fuzzer once
// found stays found.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace {

void RunOne(const std::string& bytes) {
  LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size());
}

int RunFolder(const std::filesystem::path& folder) {
  int count = 0;
  for (const auto& entry : std::filesystem::directory_iterator(folder)) {
    std::ifstream file(entry.path(), std::ios::binary);
    RunOne({std::istreambuf_iterator<char>(file), {}});
    ++count;
  }
  return count;
}

}  // namespace

int main(int argumentCount, char** arguments) {
  RunOne({});
  for (int place = 1; place < argumentCount; ++place) {
    const int count = RunFolder(arguments[place]);
    std::printf("%s: %d inputs\n", arguments[place], count);
    if (count == 0) return 1;
  }
  return argumentCount > 1 ? 0 : 1;
}
