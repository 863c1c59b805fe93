// The signs and words of the expression language that are neither names nor numbers, with what each means and
// how it is used. Every token of the vocabulary has a row.
#pragma once

#include <span>
#include <string_view>

namespace tessal {

struct SignReference {
  std::string_view sign;     ///< as it is written
  std::string_view example;  ///< an expression that parses
  std::string_view meaning;  ///< a sentence
};

/// Signs of one use.
struct SignGroup {
  std::string_view title;
  std::string_view note;  ///< what holds for all of them; sentences, or empty
  std::span<const SignReference> signs;
};

std::span<const SignGroup> SignGroups();

}  // namespace tessal
