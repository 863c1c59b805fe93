// Every message that a load, a check, a change or a save can give, one row each. The tool's `explain`, its
// reports for code hosts and docs/messages.md are made from these rows; a program refers to a message by its
// code (see messages.h).
#pragma once

#include <cstdint>
#include <string_view>

namespace tessal {

/// The severity of a message. Only a fatal one changes the flow of control: it makes a load fail.
enum class ErrorLevel : std::uint32_t {
  Undefined = 0,  ///< of undefined symbols, which templates list themselves, beside the registry
  Notice = 1,
  Warning = 2,
  Critical = 3,
  Fatal = 4
};

/// What of an element a message is about, so that its place in the file can be found.
enum class MessageTopic : std::uint8_t {
  Element,  ///< all of it
  Syntax,   ///< where one of its expressions stops parsing
  Call,     ///< a call or a property in one of its expressions
  Name,     ///< a name that one of its expressions uses
  Text,     ///< the character that one of its descriptive texts may not have
  Field     ///< the value of a keyword
};

struct MessageSubject {
  MessageTopic topic = MessageTopic::Element;
  std::uint8_t value = 0;      ///< which of the message's values is the name, from 1
  std::string_view keyword{};  ///< of the field
};

constexpr MessageSubject AboutName(std::uint8_t value) {
  return {MessageTopic::Name, value};
}
constexpr MessageSubject AboutField(std::string_view keyword) {
  return {MessageTopic::Field, 0, keyword};
}
inline constexpr MessageSubject kAboutSyntax{MessageTopic::Syntax};
inline constexpr MessageSubject kAboutCall{MessageTopic::Call};
inline constexpr MessageSubject kAboutText{MessageTopic::Text};

struct MessageRow {
  std::string_view code;  ///< for machines: stays the same in all versions
  ErrorLevel level;
  std::string_view text;     ///< %1, %2 and so on are the places of its values
  std::string_view meaning;  ///< one line
  std::string_view example;  ///< one line
  std::string_view remedy;   ///< one line
  MessageSubject about{};
};

inline constexpr MessageRow kMessages[] = {
    // The file.
    {
        "file-not-opened",
        ErrorLevel::Fatal,
        "Can not open file %1\n",
        "The file does not exist, may not be read, or is no regular file.",
        "tessal check misspelt.tessal",
        "Check the path and the permissions of the file.",
    },
    {
        "file-too-large",
        ErrorLevel::Fatal,
        "File %1 is larger than %2 bytes\n",
        "No larger file is read: places in it are counted in 32 bits.",
        "tessal check results.csv",
        "Check that the path is that of a template. One of a million elements has some 400 MB.",
    },
    {
        "file-syntax",
        ErrorLevel::Fatal,
        "Synthax error near line %1 position %2 : %3\n",
        "The file is no key file, or is damaged at the place that is named; nothing of it was loaded.",
        "A section without its EndSect, or a text whose closing quote is missing.",
        "Open the file in a text editor and repair the line, or take a copy from before the damage.",
    },
    {
        "load-failed",
        ErrorLevel::Fatal,
        "%1\n",
        "The load ended early for the reason that is given; the template is incomplete.",
        "A file with five equations for four state variables.",
        "Remove what the reason and the other messages name, and load again; do not save over the file "
        "before.",
    },
    {
        "missing-key",
        ErrorLevel::Critical,
        "could not find key %1 in %2",
        "A section lacks a keyword that it must have, or its value cannot be read; the default value is "
        "used.",
        "A section CONSTANT_5 without a line MAX_VALUE = 10.",
        "Add the keyword to the section, or set the value in the editor and save.",
    },
    {
        "surplus-equations",
        ErrorLevel::Critical,
        "STATE_VARIABLE_EQUATIONS has more sub-sections than there are state variables",
        "Equations belong to state variables by their place, and here are more of them; the load fails.",
        "A state variable was deleted from the file by hand, and its equation was left.",
        "Delete the sub-sections of STATE_VARIABLE_EQUATIONS that belong to no state variable.",
    },
    {
        "sections-not-kept",
        ErrorLevel::Warning,
        "%1",
        "What lies in the file beside TESSAL_SETUP is no item tree; a save keeps its text all the same.",
        "An empty file, or a section that uses a notation which only other programs read.",
        "Repair the place that is named, or keep a copy of the file before you save.",
    },
    // The account of a load: what it did not take over as it is in the file. None of these is in the list of
    // messages.
    {
        "key-absent",
        ErrorLevel::Notice,
        "%1 of %2 is missing",
        "The file lacks a keyword; the value is empty, or the default of its kind. Nothing of the file is "
        "lost.",
        "A constant without a line UNIT.",
        "Set the value and save, so that the file has it.",
    },
    {
        "section-absent",
        ErrorLevel::Notice,
        "the section %1 is missing",
        "The file lacks a section that every saved template has; what it holds is empty. Nothing of the file "
        "is "
        "lost.",
        "A file without [CONSTANTS].",
        "Nothing, unless the section was removed by mistake.",
    },
    {
        "value-not-read",
        ErrorLevel::Notice,
        "%1 of %2 was not read, since %3",
        "A number is in the file, but numbers are not read after a key that is missing; a save writes "
        "another "
        "value in its place.",
        "DEFAULT_VALUE = 0.2 of a constant that has no UNIT.",
        "Use \"Read Them\" in the editor or tessal repair, which take the values over.",
    },
    {
        "value-of-wrong-type",
        ErrorLevel::Notice,
        "%1 of %2 is no %3 and was not read",
        "A value is in the file in another type than its keyword has; a save writes another value in its "
        "place.",
        "DEFAULT_VALUE = 'about 2'",
        "Take it over with \"Read Them\" or tessal repair where it is a number between quotes, or set the "
        "value.",
    },
    {
        "value-replaced",
        ErrorLevel::Notice,
        "%1 of %2 is no choice, and was replaced by %3",
        "A value is none of those that its keyword can have, and another took its place; a save writes that "
        "one.",
        "FRAMEWORK = 'GRID' of a search function.",
        "Choose the value that was meant, and save.",
    },
    {
        "value-cut",
        ErrorLevel::Notice,
        "%1 of %2 was cut to %3",
        "A value does not fit, and a part of it or its nearest limit was read; a save writes that.",
        "RANDSEED = 99999999999",
        "Set the value that was meant, and save.",
    },
    {
        "equation-misnamed",
        ErrorLevel::Notice,
        "%1 of %2 was not read, since it has another name than the state variable",
        "The keyword of an equation is the symbol of its state variable; under another name it is not read, "
        "and "
        "a save writes the default in its place.",
        "NO3 = '\"-denitrification\"' as the equation of NH4.",
        "Use \"Read Them\" in the editor or tessal repair, if it is the equation of this variable.",
    },
    {
        "groups-not-read",
        ErrorLevel::Notice,
        "%1 visibility groups were not read, since %2",
        "The file holds visibility groups that were passed over after a key that is missing; a save leaves "
        "them "
        "out.",
        "A section VISIBILITY_GROUPS without DOCUMENTATION.",
        "Use \"Read Them\" in the editor or tessal repair, which take the groups over.",
    },
    {
        "items-not-read",
        ErrorLevel::Notice,
        "the items of the level %1 were not read, since %2",
        "The file holds the items of a level, which were passed over after a key that is missing; a save "
        "leaves "
        "them out.",
        "A level with ITEMS and without ITEMCOUNT.",
        "Use \"Read Them\" in the editor or tessal repair, which take the items over.",
    },
    {
        "item-dropped",
        ErrorLevel::Notice,
        "item %1 of the level %2 is no element and will not be kept",
        "A level lists the number of an element that the template does not have.",
        "ITEMS = 1, 99 in a template of ten elements.",
        "Nothing, or include the element that was meant in the level.",
    },
    {
        "keyword-dropped",
        ErrorLevel::Notice,
        "%1 in %2 is not read and will not be kept",
        "A section of the template holds a keyword that it does not have, or has twice; a save leaves it "
        "out.",
        "COLOUR = 'red' in CONSTANT_3.",
        "Keep the text elsewhere, in a description or in a section of its own after the template.",
    },
    {
        "values-dropped",
        ErrorLevel::Notice,
        "%1 in %2 has more values than are read; the others will not be kept",
        "A keyword has several values where one is read, or values of a type that it cannot have.",
        "UNIT = 'g', 'kg'",
        "Keep the other values elsewhere.",
    },
    {
        "section-dropped",
        ErrorLevel::Notice,
        "the section %1 in %2 is not read and will not be kept",
        "The template's section holds one that it does not have, or has twice; a save leaves it out.",
        "A second section [CONSTANTS].",
        "Move its content to where it belongs, or to a section of its own after the template.",
    },
    {
        "more-dropped",
        ErrorLevel::Notice,
        "Further parts of the file will not be kept: %1",
        "Only the first hundred thousand that nobody reads are listed one by one.",
        "[TESSAL_SETUP] with a hundred thousand keywords X1 = 1, X2 = 1 and so on",
        "Look at the first of them: the file may be no template.",
    },
    {
        "comment-dropped",
        ErrorLevel::Notice,
        "the comment %1 will not be kept",
        "A comment inside the template's section or in the head of the file; a save writes a fresh file "
        "without "
        "it.",
        "// calibrated in May",
        "Move it to the description of the element, or after the template's section.",
    },
    {
        "head-texts-dropped",
        ErrorLevel::Notice,
        "the texts of %1 will not be kept: a save writes those of %2",
        "The list head of the auxiliaries has texts of its own in the file; the format has always written "
        "those "
        "of the constants in their place.",
        "A DESCRIPTION of AUXILIARY_VARIABLES that differs from that of CONSTANTS.",
        "Keep the text in the description of an element or of the template.",
    },
    {
        "empty-list-dropped",
        ErrorLevel::Notice,
        "the texts of %1 will not be kept: a save leaves out an empty list of this kind",
        "The list of user functions or of visibility groups has texts and nothing else; the format holds "
        "such a list only with what it lists.",
        "A DESCRIPTION of VISIBILITY_GROUPS beside GROUPS = 0.",
        "Keep the text in the description of the template.",
    },
    {
        "text-dropped",
        ErrorLevel::Notice,
        "%1 bytes after a zero byte are not read and will not be kept",
        "Key-file text ends at a zero byte; what follows it in the file is left out of a save.",
        "A file that a crash has filled up with zeros.",
        "Look at the file with a viewer for bytes; take a copy from before the damage if the text breaks "
        "off.",
    },
    {
        "symbol-twice",
        ErrorLevel::Notice,
        "%1 is the symbol of several elements",
        "Two elements of the file have one symbol; expressions use the first.",
        "Two constants kp.",
        "Rename one of them.",
    },
    {
        "key-not-written",
        ErrorLevel::Critical,
        "could not write key %1: %2",
        "A value cannot be written in the key-file format; the save fails and the file on disk is unchanged.",
        "A description that holds both an apostrophe and a vertical bar.",
        "Change the value of the element so that the format can hold it, and save again.",
    },
    {
        "out-of-memory",
        ErrorLevel::Fatal,
        "not enough memory",
        "There was not enough memory to load or to save the template; the file on disk is unchanged.",
        "A file of many gigabytes, or a limit that the system sets to each program.",
        "Close other programs, or raise the limit.",
    },
    {
        "save-failed",
        ErrorLevel::Critical,
        "%1",
        "The template was not saved, for the reason that is given; the file on disk is unchanged.",
        "The folder does not exist or is read-only, or the disk is full.",
        "Remove the reason, or save under another name.",
    },

    // The fields of an element.
    {
        "value-below-minimum",
        ErrorLevel::Warning,
        "The (default) value is lower than the minimum!",
        "The value of an element lies below its own minimum.",
        "A constant with the value -1 and the minimum 0.",
        "Raise the value or lower the minimum.",
        AboutField("DEFAULT_VALUE"),
    },
    {
        "value-above-maximum",
        ErrorLevel::Warning,
        "The (default) value is higher than the maximum!",
        "The value of an element lies above its own maximum.",
        "A forcing with the value 20 and the maximum 10.",
        "Lower the value or raise the maximum.",
        AboutField("DEFAULT_VALUE"),
    },
    {
        "range-reversed",
        ErrorLevel::Warning,
        "The minimum must be less equal maximum!",
        "The minimum of an element is higher than its maximum, so that no value is right.",
        "A constant with the minimum 10 and the maximum 1.",
        "Exchange the two, or correct the one that is wrong.",
        AboutField("MIN_VALUE"),
    },
    {
        "value-outside-range",
        ErrorLevel::Warning,
        "The default value is not within minimum to maximum!",
        "Reserved. Checks report the side on which a default value lies outside its range.",
        "None: no check reports it.",
        "See value-below-minimum and value-above-maximum.",
    },
    {
        "illegal-symbol",
        ErrorLevel::Warning,
        "%1, illegal symbol name (keyword or illegal characters used)",
        "A symbol is a letter followed by letters, digits and underscores, and no word of the language.",
        "A constant with the symbol SIN or 2nd_rate.",
        "Give the element another symbol; a rename changes its uses, too.",
        AboutField("SYMBOL"),
    },
    {
        "symbol-taken",
        ErrorLevel::Warning,
        "%1, already defined!",
        "Another element has this symbol already; the change was taken back.",
        "A particle class is to be called Fish, and there is a class of that name.",
        "Choose a symbol that no other element has.",
        AboutField("SYMBOL"),
    },
    {
        "illegal-text",
        ErrorLevel::Warning,
        "Decription, online help or documentation contain illegal characters ('!')",
        "The files of the simulation engine cannot carry an exclamation mark in these texts.",
        "A process with the description: Check this!",
        "Write the text without exclamation marks.",
        kAboutText,
    },
    {
        "deprecated-builtin",
        ErrorLevel::Warning,
        "The selected built-in ID is deprecated and should not be used for new templates",
        "The input takes its value from a built-in variable that is kept for old templates only.",
        "A constant with the built-in ID of an older release.",
        "Choose a built-in variable that the list offers without the deprecated ones.",
        AboutField("BUILT_IN_ID"),
    },

    // Expressions.
    {
        "syntax-error",
        ErrorLevel::Warning,
        "Line %1 position %2 : %3\n",
        "The expression breaks the grammar; the position is that of the end of the first token that cannot "
        "be.",
        "a * (b + c",
        "Correct the expression at that position: often a bracket, an operator or a comma is missing.",
        kAboutSyntax,
    },
    {
        "nesting-too-deep",
        ErrorLevel::Warning,
        "Line %1 position %2 : memory exhausted\n",
        "The expression nests deeper than the parser's 10000 states allow.",
        "An expression that begins with twenty thousand opening brackets.",
        "Split the expression into several auxiliaries.",
        kAboutSyntax,
    },
    {
        "expression-too-long",
        ErrorLevel::Warning,
        "Line 1 position 1 : longer than %1 characters\n",
        "An expression of that length is not parsed: its names are not looked up, and no rename reaches it.",
        "a sum of 600,000 names",
        "Divide the expression among auxiliaries.",
        kAboutSyntax,
    },
    {
        "token-too-long",
        ErrorLevel::Warning,
        "Line %1 position %2 : token too long\n",
        "A name or number in the expression has 1000 characters or more.",
        "A symbol of 1200 letters.",
        "Shorten the name or the number.",
        kAboutSyntax,
    },
    {
        "unknown-function",
        ErrorLevel::Warning,
        "Unknown function '%1' !",
        "The expression calls what is neither in the function catalogue nor a user function of the template.",
        "SINUS(x)",
        "Correct the name, or declare the user function; the command 'tessal functions' lists the catalogue.",
        kAboutCall,
    },
    {
        "argument-count",
        ErrorLevel::Warning,
        "Wrong number of arguments for function %1(%2)!",
        "A function is called with more or fewer arguments than it has; its arguments are shown.",
        "SIN(1, 2)",
        "Give the function exactly the arguments that are shown.",
        kAboutCall,
    },
    {
        "deprecated-function",
        ErrorLevel::Warning,
        "The function %1 is deprecated and should not be used!",
        "The function is kept for old templates only.",
        "F1(x)",
        "Write what the function computes as an expression of its own.",
        kAboutCall,
    },
    {
        "call-incomplete",
        ErrorLevel::Warning,
        "One or more functions (%1) are not fully specified!",
        "A function call was begun and not ended; this guards the check itself, and no known text leads to "
        "it.",
        "None is known.",
        "Write the call that is named again.",
        kAboutCall,
    },
    {
        "unknown-property",
        ErrorLevel::Warning,
        "Unknown property ['%1'] !",
        "The name in square brackets is no property of a particle; capitals matter.",
        "[xpos] in place of [XPOS]",
        "Correct the name: XPOS, YPOS, ZPOS, AGE, HSPEED and the others are written in capitals.",
        kAboutCall,
    },

    // What expressions use.
    {
        "undefined-symbol",
        ErrorLevel::Undefined,
        "Undefined symbol %1",
        "An expression uses a name that no element of the template has.",
        "k * Algae in a template without an element Algae.",
        "Correct the name, or create the element; the editor offers to create it.",
        AboutName(1),
    },
    {
        "unknown-symbol",
        ErrorLevel::Warning,
        "unknown symbol name used in expression",
        "Reserved. Names that nobody has defined are listed one by one, with their users.",
        "None: no check reports it.",
        "See undefined-symbol.",
    },
    {
        "order-violated",
        ErrorLevel::Critical,
        "The symbol '%1' can not be used as it is declared after '%2'!",
        "An expression may use only what is declared before it.",
        "The auxiliary growth uses the auxiliary limit, which follows it in the list.",
        "Move the element that is used before its user.",
        AboutName(1),
    },
    {
        "not-a-process",
        ErrorLevel::Critical,
        "The symbol '%1' is not a process!",
        "The equation of a state variable may use only processes.",
        "The equation growth - k, where k is a constant.",
        "Put what the equation uses into a process, and use that process.",
        AboutName(1),
    },
    {
        "scope-violated",
        ErrorLevel::Warning,
        "'%1' has invalid scope and/or spatial variation",
        "An element varies less in space than what it uses, so that it has no single value to use.",
        "An auxiliary without spatial variation uses a forcing that varies horizontally.",
        "Let the user vary in space as what it uses does, or use something that varies less.",
        AboutName(1),
    },
    {
        "no-process-by-rule",
        ErrorLevel::Warning,
        "%1 is no process!",
        "Under the process rule, which no template selects, an equation uses what is not a process.",
        "The equation growth - k, where k is a constant.",
        "Put what the equation uses into a process, and use that process.",
        AboutName(1),
    },
    {
        "scope-violated-by-rule",
        ErrorLevel::Warning,
        "%1 has invalid scope and/or spatial variation in expression of",
        "Under the process rule, which no template selects, an element uses what varies more in space.",
        "A process without spatial variation uses a constant that varies horizontally.",
        "Let the user vary in space as what it uses does, or use something that varies less.",
        AboutName(1),
    },

    // Particle classes.
    {
        "foreign-equation-term",
        ErrorLevel::Critical,
        "The symbol'%1' is not a process of the current current specie %2",
        "The equation of a particle state variable may use only the arithmetic expressions of its class.",
        "The equation of Fish_mass uses a constant of the template.",
        "Put what the equation uses into an arithmetic expression of the class, and use that.",
        AboutName(1),
    },
    {
        "foreign-member",
        ErrorLevel::Critical,
        "The %1 '%2' does not belong to current specie %3",
        "A member of a particle class uses what belongs to another class, or what classes may not use.",
        "An expression of Fish uses a constant of Algae, or an auxiliary of the template.",
        "Declare what is used in the class itself; of the template, classes use only state variables and "
        "inputs.",
        AboutName(2),
    },
    {
        "foreign-state-variable",
        ErrorLevel::Warning,
        "The state variable '%1' does not belong to current specie %2 (only allowed if interaction!)",
        "A member of a particle class uses a state variable of another class, which is right only in an "
        "interaction.",
        "An expression of Fish uses Algae_mass outside an interaction.",
        "Use it in an interaction, or use a state variable of the own class.",
        AboutName(1),
    },
    {
        "search-without-class",
        ErrorLevel::Warning,
        "No valid specie selected",
        "A search for particles names no particle class of the template.",
        "A search function looks for the third class of a template that has two.",
        "Choose the own class, any particle, or one of the classes.",
        AboutField("LOOKFOR"),
    },
    {
        "search-without-variable",
        ErrorLevel::Warning,
        "No valid variable/property selected",
        "A search function names neither a variable nor a property that it is to look for.",
        "A new search function whose variable was not chosen yet.",
        "Choose a variable, or for particles a property.",
        AboutField("VARIABLE_ID"),
    },
    {
        "search-without-function",
        ErrorLevel::Warning,
        "Invalid math function",
        "A search function does not say how the values that it finds become one.",
        "A search function with the math function NONE.",
        "Choose one of the math functions that its purpose offers, such as MIN or AVERAGE.",
        AboutField("MATH"),
    },
    {
        "search-without-radius",
        ErrorLevel::Warning,
        "Search radius must be larger than zero",
        "The search radius of a search function is zero, negative or not a number.",
        "A new search function, whose radius is 0.",
        "Enter a radius above zero.",
        AboutField("RADIUS"),
    },
};

}  // namespace tessal
