#include "ui/auto_create_dialog.h"

#include <QDialogButtonBox>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace tessal {

namespace {

constexpr std::array<const char*, CAutoCreateDlg::kKindCount> kLabels = {"State Variable",
                                                                         "Constant",
                                                                         "Forcing",
                                                                         "Auxiliary",
                                                                         "Process",
                                                                         "Specie State Variable",
                                                                         "Specie Constant",
                                                                         "Area Search Function",
                                                                         "Specie Arithmetic Expression"};

}  // namespace

CAutoCreateDlg::CAutoCreateDlg(const QString& symbol, std::uint32_t mask, QWidget* parent) : QDialog(parent) {
  setWindowTitle(symbol);
  auto* layout = new QVBoxLayout(this);
  QRadioButton* first = nullptr;
  for (std::size_t index = 0; index < radios.size(); ++index) {
    radios[index] = new QRadioButton(QString::fromLatin1(kLabels[index]), this);
    radios[index]->setEnabled((mask >> index & 1U) != 0);
    layout->addWidget(radios[index]);
    if (first == nullptr && radios[index]->isEnabled()) first = radios[index];
  }
  auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok, this);
  buttons->addButton(QStringLiteral("Skip"), QDialogButtonBox::RejectRole);
  layout->addWidget(buttons);
  connect(buttons, &QDialogButtonBox::accepted, this, &CAutoCreateDlg::TakeChoice);
  connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
  if (first != nullptr) {
    first->setChecked(true);
    first->setFocus();
  }
}

void CAutoCreateDlg::TakeChoice() {
  for (std::size_t index = 0; index < radios.size() && chosen < 0; ++index) {
    if (radios[index]->isChecked()) chosen = static_cast<int>(index);
  }
  accept();
}

}  // namespace tessal
