#include "ui/auto_create_dialog.h"

#include <QDialogButtonBox>
#include <QRadioButton>
#include <QVBoxLayout>

#include "ui/child.h"
#include "ui/strings.h"

namespace tessal {

namespace {

struct KindRadio {
  int control;
  const char* label;
};

constexpr std::array<KindRadio, CAutoCreateDlg::kKindCount> kRadios = {{
    {1112, "State Variable"},
    {1105, "Constant"},
    {1106, "Forcing"},
    {1104, "Auxiliary"},
    {1111, "Process"},
    {1110, "Specie State Variable"},
    {1108, "Specie Constant"},
    {1109, "Area Search Function"},
    {1107, "Specie Arithmetic Expression"},
}};

}  // namespace

CAutoCreateDlg::CAutoCreateDlg(const QString& symbol, std::uint32_t mask, QWidget* parent) : QDialog(parent) {
  setWindowTitle(symbol);
  auto* layout = MakeChild<QVBoxLayout>(this);
  QRadioButton* first = nullptr;
  for (std::size_t index = 0; index < radios.size(); ++index) {
    radios[index] = MakeChild<QRadioButton>(QString::fromLatin1(kRadios[index].label), this);
    radios[index]->setObjectName(QString::number(kRadios[index].control));
    radios[index]->setEnabled((mask >> index & 1U) != 0);
    layout->addWidget(radios[index]);
    if (first == nullptr && radios[index]->isEnabled()) first = radios[index];
  }
  auto* buttons = MakeChild<QDialogButtonBox>(QDialogButtonBox::Ok, this);
  buttons->addButton(strings::kSkip, QDialogButtonBox::RejectRole);
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
