// Commands on key files as such: their trees and what differs between two.
#include <algorithm>
#include <optional>
#include <ostream>
#include <regex>
#include <streambuf>
#include <utility>

#include "cli/commands.h"
#include "keyfile/item_tree.h"
#include "keyfile/reader.h"
#include "platform/file_replacement.h"
#include "platform/text_stream.h"

namespace tessal::cli {

namespace {

/// A stream's way to the tool's result.
class ResultBuffer final : public std::streambuf {
 protected:
  std::streamsize xsputn(const char* text, std::streamsize size) override {
    Print(ForTerminal(std::string(text, static_cast<std::size_t>(size))));
    return size;
  }
  int_type overflow(int_type character) override {
    if (character == traits_type::eof()) return traits_type::not_eof(character);
    const char single = traits_type::to_char_type(character);
    xsputn(&single, 1);
    return character;
  }
};

/// Reads a tree. A file that cannot be read at all is the machine's fault, one that is no key file its own.
ExitCode ReadTree(const std::string& file, CKvfSectionItem& tree) {
  std::string failure;
  std::optional<std::string> text = ReadWholeFile(file, failure);
  if (!text) {
    Complain(failure);
    return kCallFault;
  }
  // What was read once is parsed: a pipe gives its text only once.
  if ((text->empty() ? LoadKeyFileTree(file, tree) : ParseKeyFileTree(*std::move(text), tree)) != 0)
    return kFine;
  Complain(file + ": " + KeyFileFailureText());
  return kContentFault;
}

}  // namespace

ExitCode RunTree(const std::string& file) {
  CKvfItemTree tree;
  const ExitCode read = ReadTree(file, tree);
  if (read != kFine) return read;
  ResultBuffer result;
  std::ostream stream(&result);
  stream.exceptions(std::ios::badbit);
  tree.Write(stream);
  return kFine;
}

ExitCode RunDiff(const std::string& left, const std::string& right, const std::vector<std::string>& ignored,
                 bool onlyKeywords) {
  const auto tooLong = [](const std::string& name) { return name.size() > kLongestIgnoredName; };
  if (std::any_of(ignored.begin(), ignored.end(), tooLong)) {
    Complain("a name to ignore is longer than " + std::to_string(kLongestIgnoredName) + " bytes");
    return kCallFault;
  }
  CKvfItemTree first;
  CKvfItemTree second;
  // A file that is no key file cannot be compared: that is no difference.
  if (ReadTree(left, first) != kFine || ReadTree(right, second) != kFine) return kCallFault;
  const IgnoredNames names(ignored.begin(), ignored.end());
  TextStream report;
  try {
    const bool same = first.Compare(second, &report, names.empty() ? nullptr : &names, onlyKeywords);
    Print(report.str());
    return same ? kFine : kContentFault;
  } catch (const std::regex_error& failure) {
    if (failure.code() == std::regex_constants::error_complexity) {
      Complain("a name to ignore has a back reference, which no search takes");
      return kCallFault;
    }
    Complain(std::string("a name to ignore is no regular expression: ") + failure.what());
    return kCallFault;
  }
}

}  // namespace tessal::cli
