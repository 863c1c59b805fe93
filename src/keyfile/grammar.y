// The grammar of key-file text, as an item tree is built from it.
%skeleton "../platform/lalr_tables.m4"
%define api.prefix {KeyFileGrammar}

%code requires {
#include "keyfile/scanner.h"

namespace tessal {
class CKvfBaseItem;
}
}

// A comment line or a blank line that follows one belongs to the same block: shifting is meant.
%expect 3

%union {
  tessal::KeyFilePiece piece;
  tessal::CKvfBaseItem* item;
}

%token END 0 "$end"
%token <piece> IDENTIFIER 258
%token <piece> VALUE_INT 259
%token <piece> VALUE_REAL 260
%token <piece> VALUE_BOOL 261
%token <piece> STRING_TEXT 262 "STRING"
%token <piece> COMMENT_STRING 263
%token <piece> PATH_STRING 264
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

%type <piece> comment comment_line section_start section_start_comment section_end section_name kvf_key
%type <item> header comment_block kvf_target_list kvf_section kvf_data kvf_command assignment
%type <item> commented_assignment

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
    /* nothing */                                 { $$ = nullptr; }
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
    /* nothing */                                 { $$ = {}; }
  | comment
  ;

section_start:
    LEFT_SQUARE section_name RIGHT_SQUARE         { $$ = $2; state.NoteSectionLine(); }
  ;

section_end:
    SECTION_END                                   { $$ = {}; }
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
  | empty_lines                                   { $$ = nullptr; }
  ;

assignment:
    kvf_key ASSIGN data NEWLINE                   { $$ = state.EndKey($1, {}); }
  ;

commented_assignment:
    kvf_key ASSIGN data comment NEWLINE           { $$ = state.EndKey($1, $4); }
  ;

kvf_key:
    IDENTIFIER
  ;

data:
    data COMMA value
  | value
  ;

value:
    VALUE_REAL                                    { state.AddReal($1); }
  | VALUE_INT                                     { state.AddInteger($1); }
  | VALUE_BOOL                                    { state.AddBoolean($1); }
  | value_quoted_string
  | value_path_string
  ;

value_quoted_string:
    SINGLE_QUOTE STRING_TEXT                      { state.AddQuoted($2); }
  ;

value_path_string:
    PATH_ID PATH_STRING                           { state.AddPath($2); }
  ;
