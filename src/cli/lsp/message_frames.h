// The frames of the protocol: header lines, an empty line, and a body of as many bytes as the header says.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace tessal::cli {

/// Takes bytes as they come and gives bodies as they are complete. After a frame that is none nothing can be
/// found again, so the first failure is the last word.
class FrameBuffer final {
 public:
  /// A larger body is taken for a damaged header.
  static constexpr std::size_t kLargestBody = std::size_t{1} << 29U;

  void Add(std::string_view bytes);
  /// The next complete body; nothing while more bytes are needed, and after a failure.
  std::optional<std::string> Take();
  /// To be called when no more bytes come: what is left over is a failure.
  void End();
  /// Why the bytes are no frames, in words; empty while they are.
  const std::string& Failure() const { return failure; }

 private:
  bool ReadHeader();
  bool ReadHeaderLine(std::string_view line);
  bool Fail(std::string text);

  std::string buffered;
  std::size_t start = 0;            ///< of what is not taken yet
  std::size_t scanned = 0;          ///< no end of the header begins before it
  std::optional<std::size_t> size;  ///< of the body, once its header is read
  std::string failure;
};

/// A body with its header.
std::string Framed(std::string_view body);

}  // namespace tessal::cli
