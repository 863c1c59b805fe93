                                                                  -*- m4 -*-
# What Bison writes of grammar.y: its automaton as tables, and the actions of its rules as one function. The
# loop over them is expression_automaton.cpp.

m4_include(b4_skeletonsdir/[c.m4])

# In an action $$ is a member of the value that the function returns, and $n one of those on the right side.
m4_define([b4_lhs_value], [b4_symbol_value([value], [$1], [$2])])
m4_define([b4_rhs_value], [b4_symbol_value([right@{b4_subtract([$2], [1])@}], [$3], [$4])])

m4_define([b4_integral_parser_table_define],
[inline constexpr std::int16_t kTable_$1[[]] = {
  $2
};
])

m4_define([tessal_rule_number], [[$1,]dnl
])
m4_define([YY_NULLPTR], [nullptr])

b4_output_begin([b4_parser_file_name])
[// The automaton of the expression grammar, made from grammar.y.
#pragma once

#include <cstdint>

]b4_percent_code_get([[requires]])[

namespace tessal::grammar {

/// What a symbol on the stack of the parser stands for.
union Value {
]b4_user_union_members[
};

inline constexpr int kStateCount = ]b4_states_number[;
inline constexpr int kTokenCount = ]b4_tokens_number[;
inline constexpr int kSymbolCount = ]m4_eval(b4_tokens_number + b4_nterms_number)[;
inline constexpr int kRuleCount = ]m4_eval(b4_rules_number + 1)[;  ///< that of the end of the text included
inline constexpr int kFinalState = ]b4_final_state_number[;
inline constexpr int kNoRow = ]b4_pact_ninf[;
inline constexpr int kErrorEntry = ]b4_table_ninf[;

]b4_parser_tables_define[

inline constexpr const char* kSymbolNames[] = {
  ]b4_tname[
};

/// The rules that make a value of their own. All others pass their first one on.
inline constexpr int kRulesWithAction[] = {]m4_pushdef([b4_case], m4_defn([tessal_rule_number]))b4_actions[]m4_popdef([b4_case])[};

/// The value of the left side of a rule from those of its right side.
inline Value Reduce(int rule, const Value* right, ParseState& state) {
  Value value = right[0];
  switch (rule) {
]b4_user_actions[
    default:
      break;
  }
  return value;
}

}  // namespace tessal::grammar
]b4_output_end
