#include "manual/syntax.h"

#include <algorithm>
#include <nlohmann/json.hpp>
#include <string_view>
#include <vector>

#include "elements/format_words.h"
#include "expr/function_catalogue.h"
#include "expr/scanner.h"
#include "expr/sign_reference.h"
#include "expr/word_reference.h"
#include "manual/format_tables.h"
#include "platform/ascii.h"
#include "platform/xml_text.h"

namespace tessal::manual {

namespace {

using Words = std::vector<std::string>;

/// What the three definitions know of the language.
struct Language {
  Words sections;  ///< whole names
  Words numbered;  ///< what comes before a number
  Words keywords;
  Words functions;
  Words properties;
  Words verbs;
  Words anyCase;   ///< words of expressions in any case
  Words capitals;  ///< and those in capitals only
  Words signs;     ///< the longest first
};

/// Words of expressions that mean the same in small letters.
bool IsOfAnyCase(std::string_view word) {
  std::string small(word);
  for (char& letter : small) letter = static_cast<char>(letter - 'A' + 'a');
  std::vector<ExpressionToken> tokens;
  const ScannerRest rest;
  return ScanExpressionTokens(small, tokens) && tokens.front().code != TokenCode::Identifier;
}

void SortSigns(Language& language) {
  for (const SignGroup& group : SignGroups()) {
    for (const SignReference& row : group.signs) {
      const bool isWord = IsWordCharacter(row.sign.front());
      Words& words = !isWord ? language.signs : IsOfAnyCase(row.sign) ? language.anyCase : language.capitals;
      words.emplace_back(row.sign);
    }
  }
  std::stable_sort(
      language.signs.begin(), language.signs.end(),
      [](const std::string& one, const std::string& other) { return one.size() > other.size(); });
}

Language ReadLanguage() {
  Language language;
  for (const SectionWord& section : SectionWords()) {
    (section.IsNumbered() ? language.numbered : language.sections).emplace_back(section.name);
  }
  for (const KeywordEntry& keyword : ReadFormat().keywords) language.keywords.push_back(keyword.name);
  InitCatalogues();
  for (const CatalogueFunction& function : Functions()) language.functions.push_back(function.name);
  ReleaseCatalogues();
  for (const WordReference& word : PropertyReferences()) language.properties.emplace_back(word.word);
  for (const WordReference& word : VerbReferences()) language.verbs.emplace_back(word.word);
  SortSigns(language);
  return language;
}

std::string Joined(const Words& words, std::string_view between) {
  std::string joined;
  for (const std::string& word : words) {
    if (!joined.empty()) joined += between;
    joined += word;
  }
  return joined;
}

/// Words as a regular expression, what is special in it among them.
std::string Alternatives(const Words& words) {
  std::string pattern;
  for (const std::string& word : words) {
    if (!pattern.empty()) pattern += '|';
    for (const char character : word) {
      if (!IsWordCharacter(character)) pattern += '\\';
      pattern += character;
    }
  }
  return pattern;
}

constexpr std::string_view kNumber = R"(\b[0-9]+(\.[0-9]*)?([eE][-+]?[0-9]+)?)";

std::string KateList(std::string_view name, const Words& words) {
  std::string text = "    <list name=\"" + std::string(name) + "\">\n";
  for (const std::string& word : words) text += "      <item>" + word + "</item>\n";
  return text + "    </list>\n";
}

std::string KatePattern(std::string_view attribute, const std::string& pattern, std::string_view more = "") {
  return "        <RegExpr attribute=\"" + std::string(attribute) + "\" context=\"#stay\" String=\"" +
         XmlText(pattern) + "\"" + std::string(more) + "/>\n";
}

/// A text between two quotes of a kind. What begins with a double quote is an expression.
std::string KateTexts(std::string_view name, char quote) {
  const std::string own(name);
  const std::string shown = quote == '\'' ? "&apos;" : "|";
  return "      <context name=\"" + own +
         "\" attribute=\"String\" lineEndContext=\"#stay\">\n"
         "        <DetectChar attribute=\"Quote\" context=\"" +
         own + " Expression\" char=\"&quot;\"/>\n" +
         "        <DetectChar attribute=\"String\" context=\"#pop\" char=\"" + shown +
         "\"/>\n      </context>\n" + "      <context name=\"" + own +
         " Expression\" attribute=\"Expression\" lineEndContext=\"#stay\">\n"
         "        <DetectChar attribute=\"Quote\" context=\"#pop\" char=\"&quot;\"/>\n" +
         "        <DetectChar attribute=\"String\" context=\"#pop#pop\" char=\"" + shown +
         "\"/>\n        <IncludeRules context=\"Expression\"/>\n      </context>\n";
}

/// What lies outside quotes, comments among it, and the quoted texts.
std::string KateTemplate(const Language& language) {
  std::string text = "      <context name=\"Template\" attribute=\"Normal\" lineEndContext=\"#stay\">\n";
  text += KatePattern("Section",
                      R"(^\s*\[()" + Alternatives(language.sections) + "|(" +
                          Alternatives(language.numbered) + R"()[0-9]+)\])",
                      " beginRegion=\"section\"");
  text += KatePattern("Section", R"(^\s*EndSect\b)", " endRegion=\"section\"");
  text +=
      "        <Detect2Chars attribute=\"Comment\" context=\"Comment\" char=\"/\" char1=\"/\"/>\n"
      "        <DetectChar attribute=\"String\" context=\"Text\" char=\"&apos;\"/>\n"
      "        <DetectChar attribute=\"String\" context=\"Path\" char=\"|\"/>\n"
      "        <keyword attribute=\"Keyword\" context=\"#stay\" String=\"keywords\"/>\n";
  text += KatePattern("Symbol", R"(\b[A-Za-z_][A-Za-z0-9_]*(?=\s*=))");
  text += KatePattern("Number", "[-+]?" + std::string(kNumber));
  text +=
      "      </context>\n"
      "      <context name=\"Comment\" attribute=\"Comment\" lineEndContext=\"#pop\"/>\n";
  text += KateTexts("Text", '\'') + KateTexts("Path", '|');
  return text;
}

std::string KateExpression(const Language& language) {
  std::string text =
      "      <context name=\"Remark\" attribute=\"Comment\" lineEndContext=\"#stay\">\n"
      "        <Detect2Chars attribute=\"Comment\" context=\"#pop\" char=\"*\" char1=\"/\"/>\n"
      "      </context>\n"
      "      <context name=\"Expression\" attribute=\"Expression\" lineEndContext=\"#stay\">\n"
      "        <Detect2Chars attribute=\"Comment\" context=\"Remark\" char=\"/\" char1=\"*\"/>\n"
      "        <keyword attribute=\"Control\" context=\"#stay\" String=\"any case\" insensitive=\"1\"/>\n"
      "        <keyword attribute=\"Control\" context=\"#stay\" String=\"capitals\"/>\n";
  text += KatePattern("Property", R"(\[\s*()" + Alternatives(language.properties) + R"()\s*\])");
  text += KatePattern("Verb", R"(\b()" + Alternatives(language.verbs) + R"()(?=\s*\{))");
  text +=
      "        <keyword attribute=\"Function\" context=\"#stay\" String=\"functions\" insensitive=\"1\"/>\n";
  text += KatePattern("Number", std::string(kNumber));
  text += KatePattern("Symbol", R"(\b[A-Za-z_][A-Za-z0-9_]*)");
  text += KatePattern("Operator", Alternatives(language.signs));
  return text + "      </context>\n";
}

std::string KateLooks() {
  std::string text = "    <itemDatas>\n";
  struct Look {
    std::string_view name;
    std::string_view style;
  };
  constexpr Look kLooks[] = {
      {"Normal", "dsNormal"},      {"Section", "dsImport"},      {"Keyword", "dsKeyword"},
      {"Symbol", "dsVariable"},    {"String", "dsString"},       {"Quote", "dsSpecialString"},
      {"Expression", "dsNormal"},  {"Control", "dsControlFlow"}, {"Function", "dsFunction"},
      {"Property", "dsAttribute"}, {"Verb", "dsBuiltIn"},        {"Number", "dsFloat"},
      {"Operator", "dsOperator"},  {"Comment", "dsComment"}};
  for (const Look& look : kLooks) {
    text += "      <itemData name=\"" + std::string(look.name) + "\" defStyleNum=\"" +
            std::string(look.style) + "\" spellChecking=\"" +
            (look.name == "String" || look.name == "Comment" ? "1" : "0") + "\"/>\n";
  }
  return text + "    </itemDatas>\n";
}

}  // namespace

std::string KateSyntax() {
  const Language language = ReadLanguage();
  std::string text =
      "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<!DOCTYPE language>\n"
      "<language name=\"Tessal Template\" version=\"1\" kateversion=\"5.0\" section=\"Scientific\" "
      "extensions=\"*.tessal\" mimetype=\"application/x-tessal\" casesensitive=\"1\">\n  <highlighting>\n";
  text += KateList("keywords", language.keywords) + KateList("functions", language.functions) +
          KateList("properties", language.properties) + KateList("verbs", language.verbs) +
          KateList("any case", language.anyCase) + KateList("capitals", language.capitals);
  text += "    <contexts>\n" + KateTemplate(language) + KateExpression(language) + "    </contexts>\n";
  text += KateLooks();
  return text +
         "  </highlighting>\n  <general>\n    <comments>\n"
         "      <comment name=\"singleLine\" start=\"//\"/>\n    </comments>\n"
         "    <keywords casesensitive=\"1\"/>\n  </general>\n</language>\n";
}

std::string VimDetection() {
  return "autocmd BufNewFile,BufRead *.tessal setfiletype tessal\n";
}

std::string VimSyntax() {
  const Language language = ReadLanguage();
  const auto alternatives = [](const Words& words) { return Joined(words, "|"); };
  std::string text =
      "\" Templates of aquatic process models.\nif exists('b:current_syntax')\n  finish\nendif\n\n"
      "syntax case match\nsyntax sync minlines=200\n";
  text += "syntax match tessalSection /\\v^\\s*\\[(" + alternatives(language.sections) + "|(" +
          alternatives(language.numbered) + ")\\d+)\\]/\nsyntax match tessalSection /^\\s*EndSect\\>/\n";
  text += "syntax match tessalSymbol /\\v<\\h\\w*>\\ze\\s*\\=/\n";
  text += "syntax match tessalKeyword /\\v<(" + alternatives(language.keywords) + ")>\\ze\\s*\\=/\n";
  text += "syntax match tessalNumber /\\v[-+]?<\\d+(\\.\\d*)?([eE][-+]?\\d+)?/\n";
  text += "syntax match tessalComment /\\/\\/.*$/\n";
  text +=
      "syntax region tessalString start=/'/ end=/'/ contains=tessalExpression\n"
      "syntax region tessalString start=/|/ end=/|/ contains=tessalExpression\n"
      "syntax region tessalExpression matchgroup=tessalQuote start=/\"/ end=/\"/ contained "
      "contains=@tessalOfExpression\n";
  text +=
      "syntax cluster tessalOfExpression contains=tessalName,tessalFunction,tessalControl,tessalProperty,"
      "tessalVerb,tessalValue,tessalOperator,tessalRemark\n";
  text += "syntax match tessalName /\\v<\\h\\w*>/ contained\n";
  text += "syntax match tessalValue /\\v<\\d+(\\.\\d*)?([eE][-+]?\\d+)?/ contained\n";
  // A sign of one character, or the first ones of a longer one, which look the same.
  std::string characters;
  for (const std::string& sign : language.signs) {
    for (const char character : sign) {
      if (characters.find(character) == std::string::npos) characters += character;
    }
  }
  std::string set;
  for (const char character : characters) set += std::string("\\") + character;
  text += "syntax match tessalOperator /[" + set + "]/ contained\n";
  text += "syntax match tessalFunction /\\v\\c<(" + alternatives(language.functions) + ")>/ contained\n";
  text += "syntax match tessalControl /\\v\\c<(" + alternatives(language.anyCase) + ")>/ contained\n";
  text += "syntax match tessalControl /\\v\\C<(" + alternatives(language.capitals) + ")>/ contained\n";
  text += "syntax match tessalProperty /\\v\\[\\s*(" + alternatives(language.properties) +
          ")\\s*\\]/ contained\n";
  text += "syntax match tessalVerb /\\v<(" + alternatives(language.verbs) + ")>\\ze\\s*\\{/ contained\n";
  text += "syntax region tessalRemark start=/\\/\\*/ end=/\\*\\// contained\n\n";
  struct Look {
    std::string_view name;
    std::string_view group;
  };
  constexpr Look kLooks[] = {{"Section", "PreProc"},   {"Keyword", "Statement"},   {"Symbol", "Identifier"},
                             {"Number", "Number"},     {"Comment", "Comment"},     {"String", "String"},
                             {"Quote", "Delimiter"},   {"Name", "Identifier"},     {"Value", "Number"},
                             {"Function", "Function"}, {"Control", "Conditional"}, {"Property", "Constant"},
                             {"Verb", "Special"},      {"Operator", "Operator"},   {"Remark", "Comment"}};
  for (const Look& look : kLooks) {
    text += "highlight default link tessal" + std::string(look.name) + " " + std::string(look.group) + "\n";
  }
  return text + "\nlet b:current_syntax = 'tessal'\n";
}

std::string TextMateSyntax() {
  using Json = nlohmann::ordered_json;
  const Language language = ReadLanguage();
  const auto match = [](std::string_view name, const std::string& pattern) {
    return Json{{"name", std::string(name) + ".tessal"}, {"match", pattern}};
  };
  const auto words = [](const Words& list) { return "\\b(" + Alternatives(list) + ")\\b"; };
  const auto region = [](std::string_view name, const std::string& quote, const Json& patterns) {
    return Json{
        {"name", std::string(name) + ".tessal"}, {"begin", quote}, {"end", quote}, {"patterns", patterns}};
  };
  const Json include = {{{"include", "#quoted"}}};
  Json expression = {
      Json{{"name", "comment.block.tessal"}, {"begin", "/\\*"}, {"end", "\\*/|(?=[\"'])"}},
      match("keyword.control", "(?i)" + words(language.anyCase)),
      match("keyword.control", words(language.capitals)),
      match("variable.language", "\\[\\s*(" + Alternatives(language.properties) + ")\\s*\\]"),
      match("support.function", "\\b(" + Alternatives(language.verbs) + ")(?=\\s*\\{)"),
      match("support.function", "(?i)" + words(language.functions)),
      match("constant.numeric", std::string(kNumber)),
      match("variable.other", "\\b[A-Za-z_][A-Za-z0-9_]*"),
      match("keyword.operator", Alternatives(language.signs)),
  };
  const Json grammar = {
      {"name", "Tessal Template"},
      {"scopeName", "source.tessal"},
      {"fileTypes", {"tessal"}},
      {"patterns",
       {match("entity.name.section", "^\\s*\\[(" + Alternatives(language.sections) + "|(" +
                                         Alternatives(language.numbered) + ")[0-9]+)\\]"),
        match("entity.name.section", "^\\s*EndSect\\b"), match("comment.line.double-slash", "//.*$"),
        match("keyword.other", words(language.keywords) + "(?=\\s*=)"),
        match("variable.other", "\\b[A-Za-z_][A-Za-z0-9_]*(?=\\s*=)"),
        match("constant.numeric", "[-+]?" + std::string(kNumber)),
        region("string.quoted.single", "'", include), region("string.quoted.other", "\\|", include)}},
      {"repository",
       {{"quoted",
         {{"patterns", Json::array({Json{{"name", "meta.embedded.expression.tessal"},
                                         {"begin", "\""},
                                         {"end", "\"|(?=['|]\\s*$)"},
                                         {"patterns", expression}}})}}}}}};
  return grammar.dump(2) + "\n";
}

}  // namespace tessal::manual
