#include "cli/lsp/server.h"

#include <algorithm>
#include <utility>

#include "cli/lsp/features.h"
#include "cli/lsp/unfinished_text.h"

namespace tessal::cli {

namespace {

/// An identity of a request as it may be; null for anything else.
Json IdOf(const Json& message) {
  const auto id = message.find("id");
  return id != message.end() && (id->is_number() || id->is_string()) ? Json(*id) : Json(nullptr);
}

/// What the JSON library has to say, without its own name and number of the failure.
std::string ReasonOf(const Json::exception& failure) {
  const std::string text = failure.what();
  const std::size_t end = text.find("] ");
  return end == std::string::npos ? text : text.substr(end + 2);
}

constexpr int kIncremental = 2;

Json Capabilities(ColumnUnit unit) {
  return {{"positionEncoding", unit == ColumnUnit::Bytes ? "utf-8" : "utf-16"},
          {"textDocumentSync", {{"openClose", true}, {"change", kIncremental}, {"save", true}}},
          {"hoverProvider", true},
          {"completionProvider", {{"triggerCharacters", {"[", "'"}}}},
          {"signatureHelpProvider", {{"triggerCharacters", {"(", ","}}}},
          {"definitionProvider", true},
          {"referencesProvider", true},
          {"documentHighlightProvider", true},
          {"documentSymbolProvider", true},
          {"workspaceSymbolProvider", true},
          {"foldingRangeProvider", true},
          {"renameProvider", {{"prepareProvider", true}}}};
}

/// Whether the client takes columns in bytes: the units of the text here.
bool TakesBytes(const Json& params) {
  const Json::json_pointer encodings("/capabilities/general/positionEncodings");
  if (!params.contains(encodings) || !params.at(encodings).is_array()) return false;
  const Json& offered = params.at(encodings);
  return std::find(offered.begin(), offered.end(), "utf-8") != offered.end();
}

}  // namespace

struct LanguageServer::RequestRow {
  std::string_view method;
  Json (LanguageServer::*answer)(const Json& params);
};

struct LanguageServer::NotificationRow {
  std::string_view method;
  void (LanguageServer::*take)(const Json& params);
};

/// What a request needs of a document that can not be read as a template.
enum class LanguageServer::Need : std::uint8_t {
  Text,          ///< its text will do
  Whole,         ///< nothing can be said: a part of the answer would be missing
  AtTypedPlace,  ///< the template without the line that is typed
  AtAnyPlace,    ///< the template without the lines at the fault
};

/// A request about a document.
struct LanguageServer::FeatureRow {
  std::string_view method;
  Json (*answer)(const LoadedDocument& document, const Json& params);
  Need need;
};

const LanguageServer::RequestRow LanguageServer::kRequests[] = {
    {"initialize", &LanguageServer::Initialize},
    {"shutdown", &LanguageServer::Shutdown},
    {"workspace/symbol", &LanguageServer::WorkspaceSymbols},
};

const LanguageServer::NotificationRow LanguageServer::kNotifications[] = {
    {"initialized", &LanguageServer::Initialized},   {"exit", &LanguageServer::Exit},
    {"textDocument/didOpen", &LanguageServer::Open}, {"textDocument/didChange", &LanguageServer::Change},
    {"textDocument/didSave", &LanguageServer::Save}, {"textDocument/didClose", &LanguageServer::Close},
};

const LanguageServer::FeatureRow LanguageServer::kFeatures[] = {
    {"textDocument/hover", Hover, Need::AtAnyPlace},
    {"textDocument/completion", Completions, Need::AtTypedPlace},
    {"textDocument/signatureHelp", SignatureHelp, Need::AtTypedPlace},
    {"textDocument/definition", Definition, Need::AtAnyPlace},
    {"textDocument/references", References, Need::Whole},
    {"textDocument/documentHighlight", Highlights, Need::Whole},
    {"textDocument/prepareRename", PrepareRename, Need::Whole},
    {"textDocument/rename", Rename, Need::Whole},
    {"textDocument/documentSymbol", DocumentSymbols, Need::Text},
    {"textDocument/foldingRange", FoldingRanges, Need::Text},
};

LanguageServer::LanguageServer(Send send) : sendBody(std::move(send)) {}

void LanguageServer::Receive(const std::string& body) {
  Json message = Json::parse(body, nullptr, false);
  if (message.is_discarded()) return SendError(nullptr, kParseError, "the message is no JSON");
  const auto method = message.find("method");
  if (!message.is_object()) return SendError(nullptr, kInvalidRequest, "the message is no object");
  if (method == message.end()) {
    // The server asks nothing, so an answer is for nobody.
    if (!message.contains("result") && !message.contains("error"))
      SendError(IdOf(message), kInvalidRequest, "the message has no method");
    return;
  }
  if (!method->is_string()) return SendError(IdOf(message), kInvalidRequest, "the method is no text");
  if (*method == "$/cancelRequest") {
    const Json::json_pointer id("/params/id");
    if (message.contains(id)) Cancel(message.at(id));
    return;
  }
  queue.push_back(std::move(message));
}

void LanguageServer::Cancel(const Json& id) {
  if (!id.is_number() && !id.is_string()) return;
  const auto asked =
      std::find_if(queue.begin(), queue.end(), [&id](const Json& message) { return IdOf(message) == id; });
  if (asked == queue.end()) return;
  queue.erase(asked);
  SendError(id, kRequestCancelled, "the request was cancelled");
}

void LanguageServer::Work() {
  while (!queue.empty() && !HasExited()) {
    const Json message = std::move(queue.front());
    queue.pop_front();
    Handle(message);
  }
  if (!HasExited() && phase == Phase::Running) Publish();
}

void LanguageServer::Handle(const Json& message) {
  static const Json kNoParams = Json::object();
  const auto method = message.at("method").get<std::string>();
  const auto given = message.find("params");
  const Json& params = given == message.end() || given->is_null() ? kNoParams : *given;
  if (!message.contains("id")) return Notice(method, params);
  Json id = IdOf(message);
  if (id.is_null()) return SendError(id, kInvalidRequest, "the id is neither a number nor a text");
  Answer(id, method, params);
}

void LanguageServer::Answer(const Json& id, const std::string& method, const Json& params) {
  const bool isFirst = method == "initialize";
  if (phase == Phase::Started && !isFirst)
    return SendError(id, kServerNotInitialized, "the server is not initialized");
  if (phase == Phase::ShutDown) return SendError(id, kInvalidRequest, "the server is shut down");
  if (phase == Phase::Running && isFirst)
    return SendError(id, kInvalidRequest, "the server is initialized already");
  try {
    SendResult(id, ResultOf(method, params));
  } catch (const RequestFailure& failure) {
    SendError(id, failure.code, failure.what());
  } catch (const Json::exception& failure) {
    SendError(id, kInvalidParams, ReasonOf(failure));
  }
}

Json LanguageServer::ResultOf(const std::string& method, const Json& params) {
  const auto isOfMethod = [&method](const auto& row) { return row.method == method; };
  const auto request = std::find_if(std::begin(kRequests), std::end(kRequests), isOfMethod);
  if (request != std::end(kRequests)) return (this->*request->answer)(params);
  const auto feature = std::find_if(std::begin(kFeatures), std::end(kFeatures), isOfMethod);
  if (feature == std::end(kFeatures))
    throw RequestFailure(kMethodNotFound, "there is no method '" + method + "'");
  const LoadedDocument* document = LoadedFor(DocumentOf(params), feature->need, params);
  return document == nullptr ? Json(nullptr) : feature->answer(*document, params);
}

void LanguageServer::Notice(const std::string& method, const Json& params) {
  const auto row = std::find_if(std::begin(kNotifications), std::end(kNotifications),
                                [&method](const NotificationRow& each) { return each.method == method; });
  const bool isExit = method == "exit";
  if (row == std::end(kNotifications) || (phase != Phase::Running && !isExit)) return;
  std::string reason;
  try {
    (this->*row->take)(params);
  } catch (const RequestFailure& failure) {
    reason = failure.what();
  } catch (const Json::exception& failure) {
    reason = ReasonOf(failure);
  }
  // A notification has no answer; a client shows this one in its log.
  if (!reason.empty()) SendNotice("window/logMessage", {{"type", 1}, {"message", method + ": " + reason}});
}

Json LanguageServer::Initialize(const Json& params) {
  if (TakesBytes(params)) unit = ColumnUnit::Bytes;
  const Json::json_pointer analyses("/initializationOptions/analyses");
  withAnalyses = params.contains(analyses) && params.at(analyses) == true;
  phase = Phase::Running;
  return {{"capabilities", Capabilities(unit)},
          {"serverInfo", {{"name", "tessal"}, {"version", TESSAL_VERSION}}}};
}

Json LanguageServer::Shutdown(const Json& /*params*/) {
  phase = Phase::ShutDown;
  return nullptr;
}

Json LanguageServer::WorkspaceSymbols(const Json& params) {
  const auto query = params.at("query").get<std::string>();
  Json all = Json::array();
  for (const auto& [uri, document] : documents) {
    for (Json& symbol : SymbolsWith(Loaded(document), query)) all.push_back(std::move(symbol));
  }
  return all;
}

void LanguageServer::Initialized(const Json& /*params*/) {}

void LanguageServer::Exit(const Json& /*params*/) {
  exitCode = phase == Phase::ShutDown ? 0 : 1;
}

void LanguageServer::Open(const Json& params) {
  const Json& given = params.at("textDocument");
  OpenDocument document{given.at("uri").get<std::string>(), given.at("text").get<std::string>(), nullptr,
                        ++changes};
  if (given.contains("version") && given.at("version").is_number_integer())
    document.version = given.at("version");
  const std::string uri = document.uri;
  loaded.reset();
  documents.insert_or_assign(uri, std::move(document));
  unpublished.insert(uri);
}

void LanguageServer::Change(const Json& params) {
  OpenDocument& document = DocumentOf(params);
  loaded.reset();
  document.change = ++changes;
  const Json& given = params.at("textDocument");
  if (given.contains("version") && given.at("version").is_number_integer())
    document.version = given.at("version");
  unpublished.insert(document.uri);
  ApplyChanges(document.text, params.at("contentChanges"), unit);
}

void LanguageServer::Save(const Json& params) {
  unpublished.insert(DocumentOf(params).uri);
}

void LanguageServer::Close(const Json& params) {
  const std::string uri = DocumentOf(params).uri;
  loaded.reset();
  documents.erase(uri);
  unpublished.erase(uri);
  SendNotice("textDocument/publishDiagnostics", {{"uri", uri}, {"diagnostics", Json::array()}});
}

OpenDocument& LanguageServer::DocumentOf(const Json& params) {
  const auto uri = params.at("textDocument").at("uri").get<std::string>();
  const auto hit = documents.find(uri);
  if (hit == documents.end()) throw RequestFailure(kInvalidParams, "the document is not open: " + uri);
  return hit->second;
}

const LoadedDocument& LanguageServer::Loaded(const OpenDocument& document) {
  if (loaded == nullptr || loadedChange != document.change) {
    loaded.reset();
    loaded = std::make_unique<LoadedDocument>(document, unit);
    loadedChange = document.change;
  }
  return *loaded;
}

const LoadedDocument* LanguageServer::LoadedFor(const OpenDocument& document, Need need, const Json& params) {
  const LoadedDocument& asItIs = Loaded(document);
  if (asItIs.IsLoaded() || need == Need::Text) return &asItIs;
  if (need == Need::Whole) return nullptr;
  const std::vector<LeftOut> tries =
      need == Need::AtTypedPlace ? LeftOutAt(asItIs, PositionIn(asItIs, params)) : LeftOutAtFault(asItIs);
  std::vector<std::string> texts;
  texts.reserve(tries.size());
  for (const LeftOut& leftOut : tries) texts.push_back(WithLeftOut(asItIs, leftOut));
  for (std::string& text : texts) {
    loaded.reset();
    readInstead = std::move(text);
    loaded = std::make_unique<LoadedDocument>(document, unit, readInstead);
    // It answers this request alone.
    loadedChange = kNoChange;
    if (loaded->IsLoaded()) return loaded.get();
  }
  return nullptr;
}

void LanguageServer::Publish() {
  for (const std::string& uri : std::exchange(unpublished, {})) {
    const LoadedDocument& document = Loaded(documents.at(uri));
    SendNotice("textDocument/publishDiagnostics",
               withAnalyses ? DiagnosticsWithAnalyses(document) : Diagnostics(document));
  }
}

void LanguageServer::SendJson(const Json& message) {
  // A message of the template may have cut a character.
  sendBody(message.dump(-1, ' ', false, Json::error_handler_t::replace));
}

void LanguageServer::SendResult(const Json& id, Json result) {
  Json message = {{"jsonrpc", "2.0"}, {"id", id}};
  message["result"] = std::move(result);
  SendJson(message);
}

void LanguageServer::SendError(const Json& id, int code, std::string_view text) {
  SendJson({{"jsonrpc", "2.0"}, {"id", id}, {"error", {{"code", code}, {"message", text}}}});
}

void LanguageServer::SendNotice(std::string_view method, Json params) {
  Json message = {{"jsonrpc", "2.0"}, {"method", method}};
  message["params"] = std::move(params);
  SendJson(message);
}

}  // namespace tessal::cli
