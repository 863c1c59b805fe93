#include "docgen/browser.h"

#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <sstream>

#include "support/temporary_folder.h"

namespace tessal::test {

std::optional<std::string> FindBrowser() {
  const char* path = std::getenv("PATH");
  std::istringstream folders(path == nullptr ? "" : path);
  for (std::string folder; std::getline(folders, folder, ':');) {
    for (const char* name : {"chromium", "chromium-browser", "google-chrome"}) {
      const std::string program = (std::filesystem::path(folder) / name).string();
      if (access(program.c_str(), X_OK) == 0) return program;
    }
  }
  return std::nullopt;
}

BrowserRun RunBrowser(const std::string& browser, const std::string& page) {
  const TemporaryFolder profile;
  // The sandbox refuses to run as root.
  const std::string sandbox = geteuid() == 0 ? " --no-sandbox" : "";
  const std::string home = profile.Path().string();
  const std::string line = "HOME='" + home + "' timeout -k 5 120 '" + browser +
                           "' --headless --disable-gpu --disable-dev-shm-usage --no-first-run" + sandbox +
                           " --allow-file-access-from-files --virtual-time-budget=20000 --user-data-dir='" +
                           home + "/profile' --dump-dom 'file://" + page + "' 2>/dev/null </dev/null";
  BrowserRun run;
  FILE* pipe = popen(line.c_str(), "r");
  if (pipe == nullptr) return run;
  std::array<char, 1U << 14U> buffer{};
  for (std::size_t count = 0; (count = fread(buffer.data(), 1, buffer.size(), pipe)) > 0;) {
    run.document.append(buffer.data(), count);
  }
  const int status = pclose(pipe);
  run.exitCode = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  run.started = run.exitCode == 0 && run.document.find("</html>") != std::string::npos;
  return run;
}

}  // namespace tessal::test
