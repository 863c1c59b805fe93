// Keeps the work of a document twice and gives it up, as an editor does: what the fault tests interrupt. Says
// after each step that it is done, or why it failed.
#include <unistd.h>

#include <QString>
#include <string>

#include "app/recovery_file.h"

namespace {

void Say(const QString& text) {
  const std::string line = text.toStdString() + "\n";
  if (write(STDOUT_FILENO, line.data(), line.size()) < 0) _exit(2);
}

}  // namespace

int main(int count, char** arguments) {
  if (count != 2) return 2;
  const QString path = QString::fromUtf8(arguments[1]);
  tessal::RecoveryFile recovery = path.isEmpty() ? tessal::RecoveryFile() : tessal::RecoveryFile(path);
  for (const char digit : {'1', '2'}) {
    const QString failure = recovery.Write(std::string(100000, digit));
    Say(failure.isEmpty() ? QString(QLatin1Char(digit)) : failure);
  }
  recovery.Remove();
  Say(QStringLiteral("removed"));
}
