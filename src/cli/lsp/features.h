// What the server answers about a document. Each takes the document and the `params` of the request, and
// gives its `result`; params that are none of the request's raise the JSON library's failure.
#pragma once

#include <stdexcept>
#include <string>

#include "cli/lsp/loaded_document.h"

namespace tessal::cli {

/// A request that cannot be answered, with the code of the protocol and words for the user.
struct RequestFailure : std::runtime_error {
  RequestFailure(int errorCode, const std::string& text) : std::runtime_error(text), code(errorCode) {}
  int code;
};

/// Codes of the protocol.
enum ProtocolError : int {
  kParseError = -32700,
  kInvalidRequest = -32600,
  kMethodNotFound = -32601,
  kInvalidParams = -32602,
  kServerNotInitialized = -32002,
  kRequestCancelled = -32800,
  kRequestFailed = -32803
};

/// The params of `textDocument/publishDiagnostics`.
Json Diagnostics(const LoadedDocument& document);
/// The same with what analyses find, as hints.
Json DiagnosticsWithAnalyses(const LoadedDocument& document);

Json Hover(const LoadedDocument& document, const Json& params);
Json Completions(const LoadedDocument& document, const Json& params);
Json SignatureHelp(const LoadedDocument& document, const Json& params);

Json Definition(const LoadedDocument& document, const Json& params);
Json References(const LoadedDocument& document, const Json& params);
Json Highlights(const LoadedDocument& document, const Json& params);

Json PrepareRename(const LoadedDocument& document, const Json& params);
Json Rename(const LoadedDocument& document, const Json& params);

Json DocumentSymbols(const LoadedDocument& document, const Json& params);
Json FoldingRanges(const LoadedDocument& document, const Json& params);
/// The symbols that have the letters of a query in them, for `workspace/symbol`.
Json SymbolsWith(const LoadedDocument& document, const std::string& query);

/// What is common to many answers.
std::size_t PositionIn(const LoadedDocument& document, const Json& params);
Json LocationOf(const LoadedDocument& document, std::string_view part);
/// The number that the protocol has for a kind of symbol.
int SymbolKindOf(ElementKind kind);

}  // namespace tessal::cli
