// Bytes for the language server. They come once as a stream with its frames, and once line by line as bodies
// to a server that has a document: whatever they are, each answer is JSON, and each request has one.
#include <algorithm>
#include <cstdint>
#include <nlohmann/json.hpp>
#include <string>
#include <string_view>

#include "cli/lsp/message_frames.h"
#include "cli/lsp/server.h"
#include "template_file.h"

using namespace tessal;
using cli::FrameBuffer;
using cli::Json;
using cli::LanguageServer;
using fuzz::Require;
using fuzz::TakeLine;

namespace {

constexpr std::string_view kInitialize = R"({"id":0,"method":"initialize","params":{}})";
constexpr std::string_view kOpen =
    R"({"method":"textDocument/didOpen","params":{"textDocument":{"uri":"u","text":"[TESSAL_SETUP]\n[CONSTANTS]\n)"
    R"([CONSTANT_1]\nSYMBOL = 'ä'\nEndSect\n[CONSTANT_2]\nSYMBOL = 'k'\nEndSect\nEndSect\n[AUXILIARY_VARIABLES]\n)"
    R"([AUXILIARY_VARIABLE_1]\nSYMBOL = 'a'\nEXPRESSION = '\"SIN(k) + nobody\"'\nEndSect\nEndSect\nEndSect\n"}}})";

std::size_t FeedFrames(std::string_view bytes, std::size_t piece) {
  std::size_t answers = 0;
  LanguageServer server([&answers](std::string_view body) {
    Require(Json::accept(body), "an answer is JSON");
    ++answers;
  });
  FrameBuffer frames;
  while (!bytes.empty()) {
    frames.Add(bytes.substr(0, piece));
    bytes.remove_prefix(std::min(piece, bytes.size()));
    while (const auto body = frames.Take()) server.Receive(*body);
  }
  frames.End();
  server.Work();
  return answers;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr std::size_t kLongest = 8192;
  if (size > kLongest) return 0;
  std::string_view rest(reinterpret_cast<const char*>(data), size);
  Require(FeedFrames(rest, 1) == FeedFrames(rest, kLongest), "frames do not depend on how they come");

  std::size_t answers = 0;
  LanguageServer server([&answers](std::string_view body) {
    const Json answer = Json::parse(body);
    if (answer.contains("id")) ++answers;
  });
  server.Receive(std::string(kInitialize));
  server.Receive(std::string(kOpen));
  server.Work();
  while (!rest.empty() && !server.HasExited()) {
    const std::string body = TakeLine(rest);
    const std::size_t before = answers;
    server.Receive(body);
    server.Work();
    const Json message = Json::parse(body, nullptr, false);
    const bool isRequest = message.is_object() && message.contains("id") && message.contains("method") &&
                           message["method"].is_string() && message["method"] != "$/cancelRequest";
    if (isRequest && !server.HasExited()) Require(answers == before + 1, "a request has one answer");
  }
  return 0;
}
