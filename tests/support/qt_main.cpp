// The main of test programs that show widgets: on the platform without a screen, and without the user's
// settings.
#include <gtest/gtest.h>

#include <QApplication>
#include <QStandardPaths>
#include <QTemporaryDir>

// Settings of the sanitizers, under the names that they look for: what the font library keeps for the life of
// the process is no leak, and little freed memory is held back, so that a test may watch the process's size.
#define SHOWN_TO_SANITIZERS extern "C" __attribute__((visibility("default"))) const char*
SHOWN_TO_SANITIZERS __lsan_default_suppressions();  // NOLINT(bugprone-reserved-identifier)
SHOWN_TO_SANITIZERS __asan_default_options();       // NOLINT(bugprone-reserved-identifier)

extern "C" const char* __lsan_default_suppressions() {  // NOLINT(bugprone-reserved-identifier)
  return "leak:libfontconfig\n";
}

extern "C" const char* __asan_default_options() {  // NOLINT(bugprone-reserved-identifier)
  return "quarantine_size_mb=8";
}

int main(int count, char** arguments) {
  const QTemporaryDir settings;
  qputenv("XDG_CONFIG_HOME", settings.path().toUtf8());
  qputenv("QT_QPA_PLATFORM", "offscreen");
  QApplication application(count, arguments);
  QApplication::setOrganizationName(QStringLiteral("Tessal"));
  QApplication::setApplicationName(QStringLiteral("tests"));
  testing::InitGoogleTest(&count, arguments);
  return RUN_ALL_TESTS();
}
