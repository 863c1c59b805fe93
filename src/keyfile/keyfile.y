%{
// The grammar of key-file text, as an item tree is built from it.
#include "keyfile/read_state.h"

// The parse owns what its stack needs.
#define YYMALLOC(size) state.Memory().Take(size)
#define YYFREE(block) state.Memory().Release(block)
%}

%code requires {
#include <cstdint>

namespace tessal {
class ReadState;
}
}

%code {
static int tessal_keyfile_grammar_lex(TESSAL_KEYFILE_GRAMMAR_STYPE* value, tessal::ReadState& state);
static void tessal_keyfile_grammar_error(tessal::ReadState& state, const char* message);
}

%define api.prefix {tessal_keyfile_grammar_}
%define api.pure full
%define parse.error verbose
%param { tessal::ReadState& state }

// A comment line or a blank line that follows one belongs to the same block: shifting is meant.
%expect 3

// Everything lies in the read's stores; values are places in them, so that the parser's stack can grow.
%union {
  std::uint32_t place;
}

%token END 0 "$end"
%token <place> IDENTIFIER 258
%token <place> VALUE_INT 259
%token <place> VALUE_REAL 260
%token <place> VALUE_BOOL 261
%token <place> STRING_TEXT 262 "STRING"
%token <place> COMMENT_STRING 263
%token <place> PATH_STRING 264
%token SECTION_END 265
%token COMMENT_ID 266
%token SINGLE_QUOTE 267
%token PATH_ID 268
%token LEFT_SQUARE 269
%token RIGHT_SQUARE 270
%token ASSIGN 271
%token COMMA 272
%token NEWLINE 273
// A character without a token. No rule takes it.
%token OTHER 274 "$undefined"

%type <place> header comment comment_line comment_block kvf_target_list kvf_section section_start_comment
%type <place> section_start section_end section_name kvf_data kvf_command assignment commented_assignment
%type <place> kvf_key data value value_quoted_string value_path_string

%start kvf_file

%%

kvf_file:
    header empty_lines kvf_target_list            { state.Finish($1, $3); }
  ;

empty_lines:
    NEWLINE
  | empty_lines NEWLINE
  ;

header:
    /* nothing */                                 { $$ = tessal::ReadState::kNothing; }
  | comment_block
  ;

comment:
    COMMENT_ID COMMENT_STRING                     { $$ = $2; }
  ;

comment_line:
    comment NEWLINE                               { $$ = $1; }
  ;

comment_block:
    comment_line                                  { $$ = state.NewComment($1); }
  | comment_line comment_block                    { $$ = state.PrependComment($1, $2); }
  ;

kvf_target_list:
    kvf_section kvf_target_list                   { $$ = state.PrependTarget($1, $2); }
  | kvf_section                                   { $$ = state.NewTargets($1); }
  ;

kvf_section:
    section_start section_start_comment NEWLINE kvf_data section_end empty_lines
                                                  { $$ = state.EndSection($4, $1, $2, $5); }
  ;

section_start_comment:
    /* nothing */                                 { $$ = tessal::ReadState::kNothing; }
  | comment
  ;

section_start:
    LEFT_SQUARE section_name RIGHT_SQUARE         { $$ = $2; state.NoteSectionLine(); }
  ;

section_end:
    SECTION_END                                   { $$ = tessal::ReadState::kNothing; }
  | SECTION_END comment                           { $$ = $2; }
  ;

section_name:
    IDENTIFIER
  ;

kvf_data:
    kvf_data kvf_command                          { $$ = state.AppendItem($1, $2); }
  | /* nothing */                                 { $$ = state.NewSection(); }
  ;

kvf_command:
    assignment
  | commented_assignment
  | kvf_section
  | comment_block
  | empty_lines                                   { $$ = tessal::ReadState::kNothing; }
  ;

assignment:
    kvf_key ASSIGN data NEWLINE                   { $$ = state.EndKey($3, $1, tessal::ReadState::kNothing); }
  ;

commented_assignment:
    kvf_key ASSIGN data comment NEWLINE           { $$ = state.EndKey($3, $1, $4); }
  ;

kvf_key:
    IDENTIFIER
  ;

data:
    data COMMA value                              { $$ = state.AppendValue($1, $3); }
  | value                                         { $$ = state.NewKey($1); }
  ;

value:
    VALUE_REAL                                    { $$ = state.RealValue($1); }
  | VALUE_INT                                     { $$ = state.IntegerValue($1); }
  | VALUE_BOOL                                    { $$ = state.BooleanValue($1); }
  | value_quoted_string
  | value_path_string
  ;

value_quoted_string:
    SINGLE_QUOTE STRING_TEXT                      { $$ = state.QuotedValue($2); }
  ;

value_path_string:
    PATH_ID PATH_STRING                           { $$ = state.PathValue($2); }
  ;

%%

static int tessal_keyfile_grammar_lex(TESSAL_KEYFILE_GRAMMAR_STYPE* value, tessal::ReadState& state) {
  return state.IsFull() ? OTHER : state.NextToken(value->place);
}

static void tessal_keyfile_grammar_error(tessal::ReadState& state, const char* message) { state.Fail(message); }
