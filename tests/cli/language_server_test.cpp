// The language server as a client sees it: sessions in a file of cases, the frames of the protocol, and what
// is true of all texts and changes.
//
// The input of a case gives files: `--- NAME`, and what is in it. Calls are `open NAME`, `edit OLD => NEW` of
// the first such text, and methods with a place (the text around it, with a bar where the caret is) and
// further params. Ranges are shown as lines and columns from 0.
#include "cli/lsp/server.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <random>

#include "cli/lsp/message_frames.h"
#include "cli/lsp/open_document.h"
#include "core/pools.h"
#include "core/rename.h"
#include "support/case_file.h"
#include "support/temporary_folder.h"

namespace tessal::test {
namespace {

using cli::ColumnUnit;
using cli::Json;
using cli::LanguageServer;

std::string PlaceText(const Json& position) {
  return position.at("line").dump() + ":" + position.at("character").dump();
}

/// The same with each range as one text.
Json Shortened(Json value) {
  if (value.is_object() && value.contains("start") && value.contains("end"))
    return PlaceText(value["start"]) + "-" + PlaceText(value["end"]);
  if (value.is_structured()) {
    for (Json& each : value) each = Shortened(std::move(each));
  }
  return value;
}

/// A client with one document, which keeps its own copy of the text.
class Client final {
 public:
  Client() : server([this](std::string_view body) { bodies.emplace_back(body); }) {}

  std::vector<Json> Send(const Json& message) { return SendBody(message.dump()); }
  std::vector<Json> SendBody(const std::string& body) {
    bodies.clear();
    server.Receive(body);
    server.Work();
    std::vector<Json> answers;
    for (const std::string& each : bodies) answers.push_back(Json::parse(each));
    return answers;
  }
  std::vector<Json> Notify(const std::string& method, Json params) {
    return Send({{"jsonrpc", "2.0"}, {"method", method}, {"params", std::move(params)}});
  }
  /// The result, or the error.
  Json Ask(const std::string& method, Json params) {
    const auto answers =
        Send({{"jsonrpc", "2.0"}, {"id", ++lastId}, {"method", method}, {"params", std::move(params)}});
    if (answers.empty()) return "no answer";
    EXPECT_EQ(answers.front().at("id"), lastId);
    return answers.front().contains("result") ? answers.front().at("result") : answers.front();
  }
  Json Start(Json params = Json::object()) { return Ask("initialize", std::move(params)); }

  std::vector<Json> Open(const std::string& content) {
    text = content;
    return Notify("textDocument/didOpen",
                  {{"textDocument",
                    {{"uri", kUri}, {"languageId", "tessal"}, {"version", ++version}, {"text", text}}}});
  }
  std::vector<Json> Replace(std::size_t start, std::size_t size, const std::string& inserted) {
    const Json range = {{"start", PositionOf(start)}, {"end", PositionOf(start + size)}};
    text.replace(start, size, inserted);
    return Notify("textDocument/didChange",
                  {{"textDocument", {{"uri", kUri}, {"version", ++version}}},
                   {"contentChanges", Json::array({{{"range", range}, {"text", inserted}}})}});
  }
  Json At(const std::string& method, std::size_t offset, Json params = Json::object()) {
    params["textDocument"] = {{"uri", kUri}};
    params["position"] = PositionOf(offset);
    return Ask(method, std::move(params));
  }
  Json PositionOf(std::size_t offset) const {
    return ToJson(cli::TextPositions(text, ColumnUnit::Utf16, cli::LineEnds::AllKinds).PositionOf(offset));
  }
  /// The text after the edits of an answer.
  std::string Edited(const Json& edits) const {
    const cli::TextPositions positions(text, ColumnUnit::Utf16, cli::LineEnds::AllKinds);
    std::string edited = text;
    for (auto edit = edits.rbegin(); edit != edits.rend(); ++edit) {
      const std::size_t start = positions.OffsetOf(cli::PositionFrom(edit->at("range").at("start")));
      const std::size_t end = positions.OffsetOf(cli::PositionFrom(edit->at("range").at("end")));
      edited.replace(start, end - start, edit->at("newText").get<std::string>());
    }
    return edited;
  }

  static constexpr const char* kUri = "file:///t.tessal";
  std::string text;
  LanguageServer server;

 private:
  std::vector<std::string> bodies;
  int lastId = 0;
  int version = 0;
};

std::string FileOf(const Case& each, const std::string& name) {
  const std::string mark = "--- " + name + "\n";
  const std::size_t start = each.input.find(mark);
  if (start == std::string::npos) return ReadFile(TESSAL_SOURCE_DIR "/examples/" + name);
  const std::string rest = each.input.substr(start + mark.size()) + "\n";
  return rest.substr(0, rest.find("--- "));
}

std::string Lines(const std::vector<Json>& answers) {
  std::string lines;
  for (const Json& answer : answers) {
    if (answer.value("method", "") == "textDocument/publishDiagnostics") {
      for (const Json& each : answer.at("params").at("diagnostics")) lines += Shortened(each).dump() + "\n";
      lines += "published " + std::to_string(answer.at("params").at("diagnostics").size()) + "\n";
    } else {
      lines += Shortened(answer).dump() + "\n";
    }
  }
  return lines;
}

/// One line for each of a list, else one in all.
std::string ResultLines(const Json& result) {
  const Json& list = result.is_object() && result.contains("items") ? result.at("items") : result;
  if (!list.is_array()) return Shortened(result).dump() + "\n";
  std::string lines;
  for (const Json& each : list) lines += Shortened(each).dump() + "\n";
  return lines.empty() ? "none\n" : lines;
}

std::string AnswerOf(Client& client, const Case& each, const std::string& words) {
  const std::size_t blank = std::min(words.find(' '), words.size());
  const std::string verb = words.substr(0, blank);
  std::string rest = words.substr(std::min(blank + 1, words.size()));
  if (verb == "open") return Lines(client.Open(FileOf(each, rest)));
  if (verb == "body") return Lines(client.SendBody(rest));
  if (verb == "edit") {
    const std::size_t arrow = rest.find(" => ");
    const std::string before = rest.substr(0, arrow);
    return Lines(client.Replace(client.text.find(before), before.size(), rest.substr(arrow + 4)));
  }
  const std::size_t brace = std::min(rest.find('{'), rest.size());
  const Json params = brace < rest.size() ? Json::parse(rest.substr(brace)) : Json::object();
  rest.resize(brace);
  while (!rest.empty() && rest.back() == ' ') rest.pop_back();
  if (rest.empty()) {
    if (verb.find('/') == std::string::npos) return ResultLines(client.Ask(verb, params));
    Json whole = params;
    whole["textDocument"] = {{"uri", Client::kUri}};
    return ResultLines(client.Ask(verb, whole));
  }
  const std::size_t bar = rest.find('|');
  const std::string around = rest.substr(0, bar) + rest.substr(bar + 1);
  const std::size_t place = client.text.find(around);
  if (bar == std::string::npos || place == std::string::npos) return "no such place\n";
  return ResultLines(client.At(verb, place + bar, params));
}

TEST(LanguageServer, AnswersAsTheCasesSay) {
  RunCases("cli/language_server.txt", [](const Case& each) -> Answer {
    const auto client = std::make_shared<Client>();
    const bool isStarted = each.title.find("not started") == std::string::npos;
    if (isStarted) client->Start();
    return [client, each](const CaseCall& call) { return AnswerOf(*client, each, call.words); };
  });
}

TEST(LanguageServer, HasTheTextOfTheClientAfterAnyChanges) {
  const std::string pieces[] = {"a", "\n", "\r\n", "\r", "\xC3\xA4", "\xF0\x9F\x90\x9F", "[X]\n", "'", ""};
  for (const ColumnUnit unit : {ColumnUnit::Utf16, ColumnUnit::Bytes}) {
    std::mt19937 random(4711);
    const auto below = [&random](std::size_t limit) { return random() % limit; };
    std::string given;
    for (int round = 0; round < 2000; ++round) {
      // Both ends at the start of a character.
      const auto start = [&](std::size_t place) {
        while (place < given.size() && (static_cast<unsigned char>(given[place]) & 0xC0U) == 0x80U) ++place;
        // A position within CRLF is that before it.
        if (place > 0 && place < given.size() && given[place - 1] == '\r' && given[place] == '\n') --place;
        return place;
      };
      const std::size_t from = start(below(given.size() + 1));
      const std::size_t to =
          std::max(from, start(from + below(std::min<std::size_t>(given.size() - from, 9) + 1)));
      const std::string inserted = pieces[below(std::size(pieces))] + pieces[below(std::size(pieces))];
      const cli::TextPositions positions(given, unit, cli::LineEnds::AllKinds);
      const Json range = {{"start", ToJson(positions.PositionOf(from))},
                          {"end", ToJson(positions.PositionOf(to))}};
      std::string expected = given;
      expected.replace(from, to - from, inserted);
      cli::ApplyChanges(given, Json::array({{{"range", range}, {"text", inserted}}}), unit);
      ASSERT_EQ(given, expected) << "round " << round << ", seed 4711";
      if (given.size() > 600) given.resize(0);
    }
  }
}

/// What a save writes of a text but for the pools, and the pools: a rename by the tool lays them out again.
std::string ContentOf(TemplateCore& core) {
  std::string reason;
  std::string content = core.CopyText(reason).value_or(reason);
  content.resize(std::min(content.find("[TESSAL_POOLS]"), content.size()));
  for (const Pool& pool : PoolsOf(core).pools) {
    content += pool.name + "|" + pool.expression + "|" + pool.description;
    for (const std::string& process : pool.boundary) content += "|" + process;
    content += "\n";
  }
  return content;
}

constexpr const char* kPools =
    "[TESSAL_POOLS]\n   [POOL_1]\n      NAME = 'S_S'\n      EXPRESSION = '\"S_S + 2*S_I // S_S\"'\n"
    "      BOUNDARY = 'hydrolysis', 'uptake_SS'\n      DESCRIPTION = 'S_S'\n   EndSect\nEndSect\n";

/// Renames every third symbol of a text in both ways; how many there were.
std::size_t RenameInBothWays(const std::string& text) {
  Client client;
  client.Start();
  client.Open(text);
  TemplateCore core;
  EXPECT_TRUE(core.LoadText(text));
  std::vector<std::string> symbols;
  for (const SymbolRecord& record : core.SymbolTable()) symbols.push_back(RecordSymbol(record));
  std::size_t renamed = 0;
  for (std::size_t index = 0; index < symbols.size(); index += 3) {
    const std::size_t place = text.find("'" + symbols[index] + "'");
    EXPECT_TRUE(core.LoadText(text));
    if (place == std::string::npos || !core.Rename(symbols[index], "e5_new", Rewriting::WholeNames)) continue;
    const std::string expected = ContentOf(core);
    const Json answer = client.At("textDocument/rename", place + 1, {{"newName", "e5_new"}});
    EXPECT_TRUE(core.LoadText(client.Edited(answer.at("changes").at(Client::kUri))));
    const std::string actual = ContentOf(core);
    const auto differs = std::mismatch(actual.begin(), actual.end(), expected.begin(), expected.end());
    EXPECT_TRUE(actual == expected) << symbols[index] << ": "
                                    << std::string(differs.first, actual.end()).substr(0, 200);
    ++renamed;
  }
  return renamed;
}

TEST(LanguageServer, RenamesAsTheToolDoes) {
  for (const std::string name : {"asm1", "eutrophication", "faults", "fish_larvae"}) {
    const std::string text = ReadFile(TESSAL_SOURCE_DIR "/examples/" + name + ".tessal");
    EXPECT_GT(RenameInBothWays(name == "asm1" ? text + kPools : text), 3U) << name;
  }
}

/// What a buffer makes of bytes that come in pieces.
std::string Frames(std::string_view bytes, std::size_t piece) {
  cli::FrameBuffer frames;
  std::string shown;
  const auto take = [&] {
    while (const auto body = frames.Take()) shown += "(" + *body + ")";
  };
  for (; !bytes.empty(); bytes.remove_prefix(std::min(piece, bytes.size()))) {
    frames.Add(bytes.substr(0, piece));
    take();
  }
  frames.End();
  return shown + frames.Failure();
}

TEST(MessageFrames, AreReadInPiecesOrFailWithTheReason) {
  const struct {
    std::string bytes;
    std::string expected;
  } rows[] = {
      {"Content-Length: 2\r\n\r\nab", "(ab)"},
      {"content-length:3\r\nContent-Type: x; charset=utf-8\r\n\r\nabcContent-Length: 0\r\n\r\n", "(abc)()"},
      {"", ""},
      {"Content-Length: 5\r\n\r\nab", "the input ends in the body of a message"},
      {"Content-Length: 5\r\n", "the input ends in the header of a message"},
      {"Content-Length: -5\r\n\r\nab", "a Content-Length is no number: '-5'"},
      {"Content-Length: 5 bytes\r\n\r\nab", "a Content-Length is no number: '5 bytes'"},
      {"Content-Length: 99999999999999999999999\r\n\r\n",
       "a Content-Length of '99999999999999999999999' is more than a message may have"},
      {"Content-Length: 4000000000\r\n\r\n",
       "a Content-Length of '4000000000' is more than a message may have"},
      {"Content-Length: 1\r\nContent-Length: 2\r\n\r\nab", "a message has two lengths"},
      {"Content-Type: x\r\n\r\nab", "a message has no Content-Length"},
      {"\r\n\r\nab", "a message has no Content-Length"},
      {"\x01\xFF\r\n\r\n", "a header line without a colon: ' ?'"},
      {"Content-Length: 1\r\n\r\naGET / HTTP\r\n\r\n", "(a)a header line without a colon: 'GET / HTTP'"},
      {std::string(5000, 'x'), "the header of a message does not end"},
  };
  for (const auto& row : rows) {
    for (const std::size_t piece : {std::size_t{1}, std::size_t{7}, std::size_t{100000}})
      EXPECT_EQ(Frames(row.bytes, piece), row.expected) << piece << ": " << row.bytes.substr(0, 80);
  }
}

TEST(MessageFrames, GiveBackWhatWasFramed) {
  const std::string body("\0a\r\n\r\n\xFF", 7);
  EXPECT_EQ(Frames(cli::Framed(body) + cli::Framed(""), 3), "(" + body + ")()");
  // Each frame in one piece, as clients send them.
  const std::string frame = cli::Framed(body);
  EXPECT_EQ(Frames(frame + frame, frame.size()), "(" + body + ")(" + body + ")");
}

TEST(LanguageServer, AnswersCancelledRequestsAtOnce) {
  std::vector<std::string> bodies;
  LanguageServer server([&bodies](std::string_view body) { bodies.emplace_back(body); });
  server.Receive(R"({"id":1,"method":"initialize","params":{}})");
  server.Receive(R"({"id":"two","method":"workspace/symbol","params":{"query":""}})");
  server.Receive(R"({"method":"$/cancelRequest","params":{"id":"two"}})");
  server.Receive(R"({"method":"$/cancelRequest","params":{"id":77}})");
  server.Work();
  ASSERT_EQ(bodies.size(), 2U);
  EXPECT_EQ(Json::parse(bodies[0]).at("error").at("code"), -32800);
  EXPECT_EQ(Json::parse(bodies[1]).at("id"), 1);
}

TEST(LanguageServer, EndsAsTheProtocolSays) {
  Client rude;
  rude.Start();
  rude.Notify("exit", Json::object());
  EXPECT_TRUE(rude.server.HasExited());
  EXPECT_EQ(rude.server.ExitCode(), 1);
  Client polite;
  polite.Start();
  EXPECT_TRUE(polite.Ask("shutdown", nullptr).is_null());
  EXPECT_EQ(polite.Ask("textDocument/hover", nullptr).at("error").at("code"), -32600);
  polite.Notify("exit", nullptr);
  EXPECT_TRUE(polite.server.HasExited());
  EXPECT_EQ(polite.server.ExitCode(), 0);
}

TEST(LanguageServer, CountsInBytesWhereTheClientDoes) {
  Client client;
  const Json answer =
      client.Start({{"capabilities", {{"general", {{"positionEncodings", {"utf-16", "utf-8"}}}}}}});
  EXPECT_EQ(answer.at("capabilities").at("positionEncoding"), "utf-8");
  const auto published = client.Open("[\xC3\xA4\xF0\x9F\x90\x9F]");
  EXPECT_EQ(Client().Start().at("capabilities").at("positionEncoding"), "utf-16");
  const Json symbols = client.Ask("textDocument/documentSymbol", {{"textDocument", {{"uri", Client::kUri}}}});
  EXPECT_EQ(symbols.at(0).at("range").at("end").at("character"), 8) << symbols;
}

}  // namespace
}  // namespace tessal::test
