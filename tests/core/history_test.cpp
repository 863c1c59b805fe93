#include "core/edit_history.h"

#include <gtest/gtest.h>

#include <random>

#include "core/document.h"
#include "core/loaded_template.h"
#include "expr/scanner.h"
#include "support/random_edits.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

std::vector<std::uint8_t> RandomBytes(unsigned seed, std::size_t count) {
  std::mt19937 engine(seed);
  std::vector<std::uint8_t> bytes(count);
  for (std::uint8_t& byte : bytes) byte = static_cast<std::uint8_t>(engine());
  return bytes;
}

TEST(History, TakesAnyEditsBackAndDoesThemAgain) {
  const test::TemporaryFolder folder;
  for (unsigned seed = 1; seed <= 60; ++seed) {
    ResetExpressionScanner();
    test::LoadedTemplate loaded(test::RandomTemplate(seed, static_cast<int>(5 + seed % 40)));
    SetNotifyChanges(true);
    const auto bytes = RandomBytes(seed, 40 + 10 * (seed % 30));
    fuzz::Choices choices(bytes.data(), bytes.size());
    const std::string fault = test::FaultOfHistory(*loaded, choices, 60, folder.File("again.tessal"));
    ASSERT_EQ(fault, "") << "seed " << seed;
  }
}

}  // namespace
}  // namespace tessal
