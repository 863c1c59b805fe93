# What Bison writes of a grammar: its automaton as tables, and the actions of its rules as one function, in a
# structure with the name of api.prefix. The loop over them is lalr_parser.h.

m4_include(b4_skeletonsdir/[c.m4])

# In an action $$ is a member of the value that the function returns, and $n one of those on the right side.
m4_define([b4_lhs_value], [b4_symbol_value([value], [$1], [$2])])
m4_define([b4_rhs_value], [b4_symbol_value([right@{b4_subtract([$2], [1])@}], [$3], [$4])])

m4_define([b4_integral_parser_table_define],
[  static constexpr std::int16_t kTable_$1[[]] = {
    $2
  };
])

m4_define([tessal_rule_number], [[$1,]dnl
])
m4_define([YY_NULLPTR], [nullptr])

b4_output_begin([b4_parser_file_name])
[// The automaton of a grammar, made from its file.
#pragma once

#include <cstddef>
#include <cstdint>

]b4_percent_code_get([[requires]])[

namespace tessal {

struct ]b4_api_prefix[ {
  /// What a symbol on the stack of the parser stands for.
  union Value {
  ]b4_user_union_members[
  };

  static constexpr std::size_t kStateCount = ]b4_states_number[;
  static constexpr std::size_t kTokenCount = ]b4_tokens_number[;
  static constexpr std::size_t kSymbolCount = ]m4_eval(b4_tokens_number + b4_nterms_number)[;
  static constexpr std::size_t kRuleCount = ]m4_eval(b4_rules_number + 1)[;  ///< that of the end of the text included
  static constexpr std::size_t kFinalState = ]b4_final_state_number[;
  static constexpr int kNoRow = ]b4_pact_ninf[;
  static constexpr int kErrorEntry = ]b4_table_ninf[;

]b4_parser_tables_define[

  static constexpr const char* kSymbolNames[] = {
    ]b4_tname[
  };

  /// The rules that make a value of their own. All others pass their first one on.
  static constexpr std::size_t kRulesWithAction[] = {]m4_pushdef([b4_case], m4_defn([tessal_rule_number]))b4_actions[]m4_popdef([b4_case])[};

  /// The value of the left side of a rule from those of its right side.
  template <class Parse>
  static Value Reduce(std::size_t rule, const Value* right, Parse& state) {
    Value value = right[0];
    switch (rule) {
]b4_user_actions[
      default:
        break;
    }
    return value;
  }
};

}  // namespace tessal
]b4_output_end
