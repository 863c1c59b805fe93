// Keeps the work of a document twice, as an editor does: what the fault tests interrupt. Then it ends
// ("leave"), keeps the work once more without a fault ("again"), or gives it up ("remove"). Says after each
// step that it is done, or why it failed.
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
  if (count != 3) return 2;
  const QString path = QString::fromUtf8(arguments[1]);
  const std::string end = arguments[2];
  tessal::RecoveryFile recovery = path.isEmpty() ? tessal::RecoveryFile() : tessal::RecoveryFile(path);
  const auto keep = [&recovery](char digit) {
    const QString failure = recovery.Write(std::string(100000, digit), QStringLiteral("Tessal1"));
    Say(failure.isEmpty() ? QString(QLatin1Char(digit)) : failure);
  };
  keep('1');
  keep('2');
  if (end == "again") {
    qunsetenv("SAVE_FAULT_AT");
    keep('3');
  }
  if (end != "remove") return 0;
  recovery.Remove();
  Say(QStringLiteral("removed"));
}
