// The main of test programs that show widgets: on the platform without a screen, and without the user's
// settings.
#include <gtest/gtest.h>

#include <QApplication>
#include <QStandardPaths>
#include <QTemporaryDir>

// What the font library keeps for the life of the process. The name is the leak sanitizer's.
extern "C" const char* __lsan_default_suppressions();  // NOLINT(bugprone-reserved-identifier)

extern "C" const char* __lsan_default_suppressions() {  // NOLINT(bugprone-reserved-identifier)
  return "leak:libfontconfig\n";
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
