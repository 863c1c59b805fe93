// A headless Chromium for tests of pages: what a script in a page finds out reaches the test through the
// page's own document, which the browser prints when it has run.
#pragma once

#include <optional>
#include <string>

namespace tessal::test {

/// The browser's program, or nothing where none is installed.
std::optional<std::string> FindBrowser();

struct BrowserRun {
  bool started = false;  ///< whether a document came back
  int exitCode = -1;
  std::string document;  ///< after its scripts have run
};

/// Opens the page, with a profile of its own that goes when the run ends, and waits no longer than two
/// minutes.
BrowserRun RunBrowser(const std::string& browser, const std::string& page);

}  // namespace tessal::test
