// The grammar of the expression language. Its products are a tree, or a message; nothing is evaluated.
%skeleton "../platform/lalr_tables.m4"
%define api.prefix {ExpressionGrammar}

%code requires {
#include "expr/parse_state.h"
}

// In `IF c THEN a ELSE b + 1` and `a ::= b + 1` the last expression is the longest that follows: shifting is meant.
%expect 24

%union {
  tessal::LexemeSpan lexeme;
  tessal::NodeHandle node;
}

%token END 0 "$end"
%token <lexeme> IDENTIFIER 258
%token <lexeme> INT_NUM 259
%token <lexeme> FLOAT_NUM 260
%token <lexeme> SCIENTIFIC_NUM 261
%token ADD_OP_PLUS 262
%token ADD_OP_MINUS 263
%token MUL_OP_MULTIPLY 264
%token MUL_OP_DIVIDE 265
%token COMMA 266
%token LEFT_BRACKET 267
%token RIGHT_BRACKET 268
%token LEFT_SQUARE 269
%token RIGHT_SQUARE 270
%token LEFT_CURLY 271
%token RIGHT_CURLY 272
%token EQUAL 273
%token NOT_EQUAL 274
%token BIGGER 275
%token SMALLER 276
%token BIGGER_OR_EQUAL 277
%token SMALLER_OR_EQUAL 278
%token IF 279
%token THEN 280
%token ELSE 281
%token NOT_OP 282
%token AND_OP 283
%token OR_OP 284
%token DIRECT_ASSIGN 285
%token DIRECT_PLUS 286
%token DIRECT_MINUS 287
%token DIRECT_MULTIPLY 288
%token DIRECT_DIVIDE 289
%token RVAL_ID 290
%token EXCEEDANCE_FREQUENCY 291
%token U_PLUS 292
%token U_MINUS 293
// A character without a token. No rule takes it.
%token UNDEFINED 294 "$undefined"

%left ADD_OP_PLUS ADD_OP_MINUS
%left MUL_OP_MULTIPLY MUL_OP_DIVIDE
%right U_PLUS U_MINUS

%type <node> new_expression constant rid_value simple_expression argument_list expression
%type <node> exceedance_frequency_call function_call matched_statement cond_expression boolean_expression
%type <node> boolean_OR_expression boolean_AND_expression direct_modification abm_interaction
%type <node> interaction_target interaction_modlists interaction_modlist mod_target abm_property

%start new_expression

%%

new_expression:
    expression
  ;

constant:
    INT_NUM                               { $$ = state.Leaf(tessal::NodeKind::Number, $1); }
  | FLOAT_NUM                             { $$ = state.Leaf(tessal::NodeKind::Number, $1); }
  | SCIENTIFIC_NUM                        { $$ = state.Leaf(tessal::NodeKind::Number, $1); }
  ;

rid_value:
    RVAL_ID IDENTIFIER                    { $$ = state.RidValue($2); }
  ;

simple_expression:
    IDENTIFIER                            { $$ = state.Leaf(tessal::NodeKind::Identifier, $1); }
  | constant
  | LEFT_BRACKET expression RIGHT_BRACKET { $$ = $2; }
  | abm_property
  | ADD_OP_MINUS expression %prec U_MINUS { $$ = state.Node(tessal::NodeKind::Negate, "negate", $2); }
  | ADD_OP_PLUS expression %prec U_PLUS   { $$ = $2; }
  | rid_value
  ;

argument_list:
    expression                            { $$ = state.Node(tessal::NodeKind::Argument, "Argument", $1); }
  | argument_list COMMA expression        { $$ = state.Node(tessal::NodeKind::Argument, "Argument", $1, $3); }
  ;

expression:
    matched_statement
  | direct_modification
  | abm_interaction
  | function_call
  | simple_expression
  | expression ADD_OP_PLUS expression     { $$ = state.Node(tessal::NodeKind::Arithmetic, "+", $1, $3); }
  | expression ADD_OP_MINUS expression    { $$ = state.Node(tessal::NodeKind::Arithmetic, "-", $1, $3); }
  | expression MUL_OP_MULTIPLY expression { $$ = state.Node(tessal::NodeKind::Arithmetic, "*", $1, $3); }
  | expression MUL_OP_DIVIDE expression   { $$ = state.Node(tessal::NodeKind::Arithmetic, "/", $1, $3); }
  | exceedance_frequency_call
  ;

exceedance_frequency_call:
    EXCEEDANCE_FREQUENCY LEFT_BRACKET cond_expression RIGHT_BRACKET
                                          { $$ = state.Node(tessal::NodeKind::Exceedance, "Exceedance_Frequency", $3); }
  ;

function_call:
    IDENTIFIER LEFT_BRACKET RIGHT_BRACKET { $$ = state.Leaf(tessal::NodeKind::Call, $1); }
  | IDENTIFIER LEFT_BRACKET argument_list RIGHT_BRACKET
                                          { $$ = state.Named(tessal::NodeKind::Call, $1, $3); }
  ;

matched_statement:
    IF boolean_OR_expression THEN expression ELSE expression
                                          { $$ = state.Conditional($2, $4, $6); }
  | IF LEFT_BRACKET boolean_OR_expression COMMA expression COMMA expression RIGHT_BRACKET
                                          { $$ = state.Conditional($3, $5, $7); }
  ;

cond_expression:
    expression EQUAL expression           { $$ = state.Node(tessal::NodeKind::Comparison, "==", $1, $3); }
  | expression NOT_EQUAL expression       { $$ = state.Node(tessal::NodeKind::Comparison, "!=", $1, $3); }
  | expression BIGGER expression          { $$ = state.Node(tessal::NodeKind::Comparison, ">", $1, $3); }
  | expression SMALLER expression         { $$ = state.Node(tessal::NodeKind::Comparison, "<", $1, $3); }
  | expression BIGGER_OR_EQUAL expression { $$ = state.Node(tessal::NodeKind::Comparison, ">=", $1, $3); }
  | expression SMALLER_OR_EQUAL expression
                                          { $$ = state.Node(tessal::NodeKind::Comparison, "<=", $1, $3); }
  | LEFT_BRACKET boolean_OR_expression RIGHT_BRACKET
                                          { $$ = $2; }
  ;

boolean_expression:
    cond_expression
  | NOT_OP cond_expression                { $$ = state.Not($2); }
  ;

boolean_OR_expression:
    boolean_AND_expression
  | boolean_OR_expression OR_OP boolean_AND_expression
                                          { $$ = state.Or($1, $3); }
  ;

boolean_AND_expression:
    boolean_expression
  | boolean_AND_expression AND_OP boolean_expression
                                          { $$ = state.And($1, $3); }
  ;

direct_modification:
    IDENTIFIER DIRECT_ASSIGN expression   { $$ = state.Named(tessal::NodeKind::DirectAssign, $1, $3); }
  | IDENTIFIER DIRECT_PLUS expression     { $$ = state.Named(tessal::NodeKind::DirectPlus, $1, $3); }
  | IDENTIFIER DIRECT_MINUS expression    { $$ = state.Named(tessal::NodeKind::DirectMinus, $1, $3); }
  | IDENTIFIER DIRECT_MULTIPLY expression { $$ = state.Named(tessal::NodeKind::DirectMultiply, $1, $3); }
  | IDENTIFIER DIRECT_DIVIDE expression   { $$ = state.Named(tessal::NodeKind::DirectDivide, $1, $3); }
  ;

abm_interaction:
    IDENTIFIER LEFT_CURLY interaction_target COMMA interaction_modlists RIGHT_CURLY
                                          { $$ = state.Named(tessal::NodeKind::Interaction, $1, $3, $5); }
  | IDENTIFIER LEFT_CURLY interaction_target RIGHT_CURLY
                                          { $$ = state.Named(tessal::NodeKind::Interaction, $1, $3); }
  | IDENTIFIER LEFT_CURLY interaction_target COMMA RIGHT_CURLY
                                          { $$ = state.Named(tessal::NodeKind::Interaction, $1, $3); }
  ;

interaction_target:
    LEFT_BRACKET IDENTIFIER COMMA expression RIGHT_BRACKET
        { $$ = state.Node(tessal::NodeKind::Target, "Target", state.Leaf(tessal::NodeKind::Identifier, $2), $4); }
  | LEFT_BRACKET INT_NUM COMMA expression RIGHT_BRACKET
        { $$ = state.Node(tessal::NodeKind::Target, "Target ID", state.Leaf(tessal::NodeKind::Number, $2), $4); }
  ;

interaction_modlists:
    interaction_modlist
  | interaction_modlists COMMA interaction_modlist
                                          { $$ = state.Node(tessal::NodeKind::Modlists, "Modlist", $1, $3); }
  | LEFT_BRACKET RIGHT_BRACKET            { $$ = state.Node(tessal::NodeKind::Modlists, "empty"); }
  ;

interaction_modlist:
    LEFT_BRACKET mod_target COMMA mod_target COMMA expression COMMA expression COMMA expression COMMA expression
    RIGHT_BRACKET                         { $$ = state.Modlist({$2, $4, $6, $8, $10, $12}); }
  ;

mod_target:
    IDENTIFIER                            { $$ = state.Leaf(tessal::NodeKind::Identifier, $1); }
  | INT_NUM                               { $$ = state.Leaf(tessal::NodeKind::Number, $1); }
  | abm_property
  ;

abm_property:
    LEFT_SQUARE IDENTIFIER RIGHT_SQUARE   { $$ = state.Leaf(tessal::NodeKind::Property, $2); }
  ;
