// Counts what a template holds, renames a symbol with all its uses and saves the result under another name:
//
//     count_and_rename FILE OLD NEW OUTPUT
#include <tessal/tessal.h>
#include <iostream>
#include <map>
#include <string>

namespace {

int Fail(const std::string& what, const tessal::Outcome& outcome) {
  std::cerr << what << ": " << outcome.reason << '\n';
  return 1;
}

}  // namespace

int main(int count, char** arguments) {
  if (count != 5) return Fail("usage", {false, "count_and_rename FILE OLD NEW OUTPUT"});
  const std::string file = arguments[1];

  tessal::Template model;
  if (const auto loaded = model.Load(file); !loaded) return Fail(file, loaded);
  for (const tessal::TemplateMessage& message : model.LoadMessages()) {
    std::cout << message.symbol << ": " << message.text << '\n';
  }

  std::map<tessal::Kind, int> counts;
  for (const tessal::Element& element : model.Elements()) ++counts[element.GetKind()];
  std::cout << "state variables: " << counts[tessal::Kind::StateVariable]
            << ", constants: " << counts[tessal::Kind::Constant]
            << ", processes: " << counts[tessal::Kind::Process] << '\n';

  if (const auto renamed = model.Rename(arguments[2], arguments[3]); !renamed) return Fail("rename", renamed);
  for (const tessal::Element& user : model.Find(arguments[3])->UsedBy()) {
    std::cout << user.Symbol() << " = " << user.Get("Expression").value_or("") << '\n';
  }
  if (const auto saved = model.SaveAs(arguments[4]); !saved) return Fail(arguments[4], saved);
}
