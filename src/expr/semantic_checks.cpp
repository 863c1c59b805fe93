#include "expr/semantic_checks.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <string>

#include "core/error_registry.h"
#include "expr/expression_node.h"
#include "expr/function_catalogue.h"
#include "expr/parser.h"
#include "expr/user_function_names.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

constexpr std::array<std::string_view, 24> kProperties = {
    "XPOS",         "YPOS",          "ZPOS",      "HITSTATE",  "AGE",       "HDIR",
    "HSPEED",       "VSPEED",        "PROJ_XPOS", "PROJ_YPOS", "PROJ_ZPOS", "PROJ_HITSTATE",
    "ABOVE_GROUND", "BELOW_SURFACE", "PREV_XPOS", "PREV_YPOS", "PREV_ZPOS", "PREV_HITSTATE",
    "PARTICLEID",   "SOURCEID",      "PROJ_TIME", "VIEWANGLE", "ALIVE",     "ALL"};
constexpr std::array<std::string_view, 6> kVerbs = {"CREATE",   "REMOVE", "KILL",
                                                    "TRANSFER", "SPLIT",  "GETVALUE"};
constexpr std::array<std::string_view, 3> kConditionalWords = {"IF", "THEN", "ELSE"};

template <class Words>
bool Holds(const Words& words, std::string_view text) {
  return std::find(words.begin(), words.end(), text) != words.end();
}

/// Whether a text as a whole converts to a number by the rules of the "C" locale. The conversion of the empty
/// text, and of blanks with nothing after them, stops where it starts.
bool ReadsAsNumber(std::string_view text) {
  if (text.empty()) return true;
  constexpr std::string_view kBlanks = " \t\n\v\f\r";
  const std::size_t start = text.find_first_not_of(kBlanks);
  if (start == std::string_view::npos) return false;
  std::string_view digits = text.substr(start);
  if (digits.front() == '+' || digits.front() == '-') digits.remove_prefix(1);
  if (digits.empty() || digits.front() == '-' || digits.front() == '+') return false;
  const bool isHex = digits.size() > 2 && digits[0] == '0' && (digits[1] == 'x' || digits[1] == 'X');
  if (isHex) digits.remove_prefix(2);
  double value = 0.0;
  const auto result = std::from_chars(digits.data(), digits.data() + digits.size(), value,
                                      isHex ? std::chars_format::hex : std::chars_format::general);
  return result.ec != std::errc::invalid_argument && result.ptr == digits.data() + digits.size();
}

/// One check of one expression. `report` is called with each finding, the name that it is about, and the
/// number of arguments given to it.
template <class Report>
class FunctionCheck final {
 public:
  explicit FunctionCheck(Report reportFinding) : report(reportFinding) {}

  void Walk(const ExpressionNode& root) {
    root.WalkPostOrder(
        nullptr, [this](NodeKind kind, std::string_view text, std::int32_t) { Visit(kind, text); },
        [this](NodeKind kind, std::string_view, std::int32_t) {
          if (kind == NodeKind::Call) --callDepth;
        });
  }

  bool IsBalanced() const { return callDepth < 1; }
  std::string_view LastCall() const { return lastCall; }

 private:
  void Visit(NodeKind kind, std::string_view text) {
    if (kind == NodeKind::Argument) {
      // The walk comes to a list after all calls in it, so this counts the arguments of one call only.
      ++arguments;
    } else if (kind == NodeKind::Property) {
      if (!IsPropertyName(text)) report({"unknown-property", {text}}, text, 0);
    } else if (kind == NodeKind::Call) {
      CheckCall(text);
      ++callDepth;
      lastCall = text;
      arguments = 0;
    }
  }

  void CheckCall(std::string_view name) {
    const CatalogueFunction* function = FindFunction(name);
    if (function == nullptr) {
      if (!IsUserFunctionName(name)) report({"unknown-function", {name}}, name, arguments);
      return;
    }
    if (function->argumentCount != arguments) {
      report({"argument-count", {name, JoinedArguments(*function)}}, name, arguments);
    }
    if (function->traits.isDeprecated) {
      report({"deprecated-function", {name}}, name, arguments);
    }
  }

  Report report;
  std::int32_t arguments = 0;
  std::int32_t callDepth = 0;
  std::string_view lastCall;
};

}  // namespace

bool CheckFunctions(std::string_view symbol, Uid uid, const ParsedExpression& parsed) {
  const auto report = [symbol, uid](const Finding& finding, std::string_view /*name*/,
                                    std::int32_t /*arguments*/) {
    Errors().ReportCheck(symbol, uid, finding);
  };
  const ExpressionNode* tree = parsed.Tree();
  if (tree == nullptr) {
    report(parsed.Failure()->finding, {}, 0);
    return false;
  }
  FunctionCheck check(report);
  check.Walk(*tree);
  if (check.IsBalanced()) return true;
  report({"call-incomplete", {check.LastCall()}}, {}, 0);
  return false;
}

std::vector<CallFinding> FindCallFaults(const ExpressionNode& tree) {
  std::vector<CallFinding> faults;
  FunctionCheck check([&faults](const Finding& finding, std::string_view name, std::int32_t arguments) {
    faults.push_back({finding, name, arguments});
  });
  check.Walk(tree);
  return faults;
}

int CheckFunctionsSpecified(std::string_view symbol, Uid uid, std::string_view expression) {
  return CheckFunctions(symbol, uid, *ParseExpression(expression)) ? 1 : 0;
}

std::span<const std::string_view> PropertyNames() {
  return kProperties;
}

std::span<const std::string_view> InteractionVerbs() {
  return kVerbs;
}

bool IsPropertyName(std::string_view text) {
  return Holds(kProperties, text);
}

bool IsInteractionVerb(std::string_view text) {
  return Holds(kVerbs, text);
}

bool IsConditionalWord(std::string_view text) {
  return Holds(kConditionalWords, text);
}

bool IsValidSymbolSpelling(std::string_view text) {
  return !text.empty() && IsAsciiLetter(text.front()) &&
         std::all_of(text.begin(), text.end(), IsWordCharacter);
}

bool IsValidSymbol(std::string_view text) {
  return IsValidSymbolSpelling(text) && !IsUserFunctionName(text) && !IsConditionalWord(text) &&
         !IsInteractionVerb(text) && FunctionIdByName(text) < 0;
}

bool IsReservedName(std::string_view text) {
  const std::string upper = UpperCase(text);
  return FunctionIdByName(upper) >= 0 || IsConditionalWord(upper) || IsInteractionVerb(upper) ||
         ReadsAsNumber(text);
}

}  // namespace tessal
