// The language server: takes the bodies of messages, answers requests one after another in their order, and
// publishes what is wrong with the open documents when nothing else is left to do.
#pragma once

#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <string_view>

#include "cli/lsp/loaded_document.h"

namespace tessal::cli {

class LanguageServer final {
 public:
  using Send = std::function<void(std::string_view body)>;

  /// Each body that is to go to the client is given to `send`.
  explicit LanguageServer(Send send);

  /// Puts a message in the queue. A cancellation takes effect at once; what is no message is answered so.
  void Receive(const std::string& body);
  /// Answers all that is in the queue, and publishes.
  void Work();

  bool HasExited() const { return exitCode.has_value(); }
  /// As the protocol has it: 0 after a shutdown, else 1.
  int ExitCode() const { return exitCode.value_or(1); }

 private:
  struct RequestRow;
  struct NotificationRow;
  struct FeatureRow;
  enum class Need : std::uint8_t;
  static const RequestRow kRequests[];
  static const NotificationRow kNotifications[];
  static const FeatureRow kFeatures[];

  void Handle(const Json& message);
  void Answer(const Json& id, const std::string& method, const Json& params);
  Json ResultOf(const std::string& method, const Json& params);
  void Notice(const std::string& method, const Json& params);
  void Cancel(const Json& id);

  Json Initialize(const Json& params);
  Json Shutdown(const Json& params);
  Json WorkspaceSymbols(const Json& params);
  void Initialized(const Json& params);
  void Exit(const Json& params);
  void Open(const Json& params);
  void Change(const Json& params);
  void Close(const Json& params);
  void Save(const Json& params);

  OpenDocument& DocumentOf(const Json& params);
  const LoadedDocument& Loaded(const OpenDocument& document);
  /// The document, or where it is no template what of it will do for a request; none where nothing will.
  const LoadedDocument* LoadedFor(const OpenDocument& document, Need need, const Json& params);
  void Publish();

  void SendJson(const Json& message);
  void SendResult(const Json& id, Json result);
  void SendError(const Json& id, int code, std::string_view text);
  void SendNotice(std::string_view method, Json params);

  enum class Phase : std::uint8_t { Started, Running, ShutDown };

  static constexpr std::uint64_t kNoChange = 0;

  Send sendBody;
  std::deque<Json> queue;
  Phase phase = Phase::Started;
  ColumnUnit unit = ColumnUnit::Utf16;
  bool withAnalyses = false;
  std::map<std::string, OpenDocument> documents;
  std::set<std::string> unpublished;
  std::uint64_t changes = 0;
  std::unique_ptr<LoadedDocument> loaded;
  std::uint64_t loadedChange = kNoChange;
  std::string readInstead;  ///< what `loaded` was read from, where it is not the text of the document
  std::optional<int> exitCode;
};

}  // namespace tessal::cli
