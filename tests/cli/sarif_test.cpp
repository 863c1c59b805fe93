// Reports for code hosts keep to the published format, SARIF 2.1.0 (OASIS, 2020): the table holds, of the
// objects that reports have, the members that they use, with what the standard wants of each. A member that
// is not in the table is a fault too, since the format allows none of another's.
#include <gtest/gtest.h>

#include <cstdlib>
#include <nlohmann/json.hpp>
#include <regex>
#include <set>
#include <sstream>
#include <string>

#include "support/temporary_folder.h"

namespace tessal::test {
namespace {

using Json = nlohmann::json;

/// An object, and its members: a name, `!` for one that must be there, and what it holds. That is a kind of
/// value, `=` and the words of a choice, another object, `[x]` for a list or `{x}` for an object by names.
struct Shape {
  const char* name;
  const char* members;
};

constexpr Shape kShapes[] = {
    {"log", "$schema:uri version!:=2.1.0 runs!:[run]"},
    {"run",
     "tool!:tool results:[result] invocations:[invocation] automationDetails:automation "
     "originalUriBaseIds:{artifact} columnKind:=utf16CodeUnits,unicodeCodePoints"},
    {"tool", "driver!:component"},
    {"component", "name!:text version:text semanticVersion:text informationUri:uri rules:[rule]"},
    // Code hosts want what the format leaves open.
    {"rule",
     "id!:text name!:text shortDescription!:message fullDescription!:message help!:multiformat helpUri:uri "
     "defaultConfiguration!:configuration properties!:properties"},
    {"multiformat", "text!:text markdown!:text"},
    {"message", "text!:text"},
    {"configuration", "level!:=none,note,warning,error"},
    {"properties",
     "tags!:[text] precision!:=very-high,high,medium,low problem.severity!:=recommendation,warning,error"},
    {"invocation", "executionSuccessful!:bool"},
    {"automation", "id:text"},
    {"artifact", "uri:uri uriBaseId:text description:message"},
    {"result",
     "ruleId!:text ruleIndex!:index level!:=none,note,warning,error message!:message locations!:[location] "
     "partialFingerprints!:fingerprints"},
    {"fingerprints", "primaryLocationLineHash!:text"},
    {"location", "physicalLocation!:physical"},
    {"physical", "artifactLocation!:artifact region!:region"},
    {"region", "startLine!:count startColumn:count endColumn:count"},
};

class Validation final {
 public:
  /// What breaks the rules, a line each.
  std::string FaultsOf(const Json& log) {
    Check("log", log, "$");
    std::string lines;
    for (const std::string& fault : faults) lines += fault + "\n";
    return lines;
  }

 private:
  void Expect(bool isRight, const std::string& place, const std::string& rule) {
    if (!isRight) faults.insert(place + ": " + rule);
  }

  void Check(const std::string& kind, const Json& value, const std::string& place) {
    if (kind.front() == '=') {
      const std::string words = "," + kind.substr(1) + ",";
      Expect(value.is_string() && words.find("," + value.get<std::string>() + ",") != std::string::npos,
             place, "one of " + kind.substr(1));
    } else if (kind.front() == '[') {
      Expect(value.is_array(), place, "a list");
      for (const Json& item : value) Check(kind.substr(1, kind.size() - 2), item, place + "[]");
    } else if (kind.front() == '{') {
      Expect(value.is_object(), place, "an object");
      for (const auto& [name, item] : value.items())
        Check(kind.substr(1, kind.size() - 2), item, place + "{}");
    } else if (kind == "text") {
      Expect(value.is_string() && !value.get<std::string>().empty(), place, "a text");
    } else if (kind == "uri") {
      static const std::regex reference("[A-Za-z0-9._~!$&'()*+,;=:@/?#%-]+");
      Expect(value.is_string() && std::regex_match(value.get<std::string>(), reference), place, "a URI");
    } else if (kind == "count" || kind == "index") {
      Expect(value.is_number_integer() && value >= (kind == "count" ? 1 : 0), place, "a number");
    } else if (kind == "bool") {
      Expect(value.is_boolean(), place, "true or false");
    } else {
      CheckObject(kind, value, place);
    }
  }

  void CheckObject(const std::string& name, const Json& value, const std::string& place) {
    for (const Shape& shape : kShapes) {
      if (shape.name != name) continue;
      Json left = value;
      std::istringstream members(shape.members);
      for (std::string member; members >> member;) {
        const std::size_t colon = member.find(':');
        const bool isNeeded = member[colon - 1] == '!';
        const std::string key = member.substr(0, colon - (isNeeded ? 1 : 0));
        Expect(!isNeeded || value.contains(key), place + "." + key, "must be there");
        if (value.contains(key)) Check(member.substr(colon + 1), value[key], place + "." + key);
        left.erase(key);
      }
      Expect(left.empty(), place, "no member of the format: " + left.dump());
      return;
    }
    ADD_FAILURE() << name << " is no shape";
  }

  std::set<std::string> faults;
};

Json LogOf(const std::string& arguments) {
  const TemporaryFolder folder;
  const std::string output = folder.File("log");
  const std::string call = "cd '" TESSAL_SOURCE_DIR "' && PATH='" TESSAL_TOOL_FOLDER "':\"$PATH\" tessal " +
                           arguments + " --format sarif >'" + output + "' 2>/dev/null </dev/null";
  EXPECT_NE(std::system(call.c_str()), -1);
  return Json::parse(ReadFile(output));
}

class Sarif : public testing::TestWithParam<const char*> {};

TEST_P(Sarif, KeepsToThePublishedFormat) {
  const Json log = LogOf(GetParam());
  EXPECT_EQ(Validation().FaultsOf(log), "");
  const Json& run = log["runs"][0];
  const Json& rules = run["tool"]["driver"]["rules"];
  std::set<std::string> places;
  for (const Json& result : run["results"]) {
    EXPECT_EQ(rules.at(result["ruleIndex"].get<std::size_t>())["id"], result["ruleId"]);
    const Json& place = result["locations"][0]["physicalLocation"];
    const Json& region = place["region"];
    if (region.contains("endColumn")) {
      EXPECT_GT(region["endColumn"], region["startColumn"]) << result;
    }
    const std::string uri = place["artifactLocation"]["uri"];
    const bool isAbsolute = uri.find(':') != std::string::npos;
    EXPECT_NE(isAbsolute, place["artifactLocation"].contains("uriBaseId")) << uri;
    const std::string fingerprint = result["partialFingerprints"]["primaryLocationLineHash"];
    EXPECT_TRUE(places.insert(uri + " " + fingerprint).second) << "twice: " << result;
  }
}

INSTANTIATE_TEST_SUITE_P(Reports, Sarif,
                         testing::Values("check ./examples missing.tessal", "check /dev/null -",
                                         "lint examples", "units examples/faults.tessal"));

}  // namespace
}  // namespace tessal::test
