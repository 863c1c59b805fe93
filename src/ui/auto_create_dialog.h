// Asks what kind of element an undefined symbol shall become.
#pragma once

#include <QDialog>
#include <array>
#include <cstdint>

#include "core/creation.h"

class QRadioButton;

namespace tessal {

class CAutoCreateDlg final : public QDialog {
  Q_OBJECT

 public:
  static constexpr std::size_t kKindCount = CreationOffer::kChoiceCount;

  /// Bit n of the mask enables the kind with index n.
  CAutoCreateDlg(const QString& symbol, std::uint32_t mask, QWidget* parent);

  /// The index of the chosen kind, or -1 when the dialog was skipped.
  int ChosenIndex() const { return chosen; }
  const std::array<QRadioButton*, kKindCount>& Radios() const { return radios; }

 private:
  void TakeChoice();

  std::array<QRadioButton*, kKindCount> radios{};
  int chosen = -1;
};

}  // namespace tessal
