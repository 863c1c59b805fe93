// What was open when the application was closed last: the files in the order of their tabs, the place in
// each, and which was in front. Kept in the settings.
#pragma once

#include <QString>
#include <string>
#include <vector>

namespace tessal {

struct SessionFile {
  QString path;
  std::string place;  ///< what the view gives as its place
};

struct Session {
  std::vector<SessionFile> files;
  int front = 0;  ///< the place among the files
};

/// The session that was kept last, without files that are gone.
Session KeptSession();
void KeepSession(const Session& session);

/// Whether the user wants it back whenever the application starts without files.
bool RestoresSession();
void SetRestoresSession(bool restores);

}  // namespace tessal
