#include "ui/general_page.h"

#include <QCheckBox>
#include <QFile>
#include <QFileInfo>

#include "core/document.h"
#include "ui/child.h"
#include "ui/form_tables.h"
#include "ui/strings.h"

namespace tessal {

CGeneralPpg::CGeneralPpg(const FormContext& context, QWidget* parent)
    : CElementForm(kGeneralForm, context, parent),
      misc(AddOption(1064, strings::kEnableMisc)),
      particles(AddOption(1065, strings::kEnableParticles)),
      allBuiltIns(AddOption(1131, strings::kShowAllBuiltIns)) {
  // It only informs.
  misc->setEnabled(false);
  connect(misc, &QCheckBox::clicked, this, [this](bool on) { ShowBranch("Misc", hint::kShowMisc, on); });
  connect(particles, &QCheckBox::clicked, this,
          [this](bool on) { ShowBranch("Particle", hint::kShowParticles, on); });
  connect(allBuiltIns, &QCheckBox::clicked, this, [this](bool on) { Core().SetShowAllBuiltIns(on); });
}

QCheckBox* CGeneralPpg::AddOption(int control, const QString& caption) {
  auto* option = MakeChild<QCheckBox>(caption, this);
  option->setObjectName(QString::number(control));
  option->setAccessibleName(caption);
  AddUnder(option);
  return option;
}

CEL_Element* CGeneralPpg::Element() const {
  return &Core().Root();
}

void CGeneralPpg::ItemToForm() {
  CElementForm::ItemToForm();
  misc->setChecked(Core().GetMisc() != nullptr);
  particles->setChecked(Core().GetSpecieCount() > 0);
  allBuiltIns->setChecked(Core().ShowAllBuiltIns());
}

QString CGeneralPpg::DocumentationFolder() const {
  const QString file = QFile::decodeName(Core().TemplateFileName().c_str());
  return file.isEmpty() ? QString() : QFileInfo(file).absolutePath();
}

void CGeneralPpg::ShowBranch(const char* state, int hintNumber, bool on) {
  Item().viewState[state] = std::string(1, on ? '1' : '0');
  const NumberHint argument(on ? 1 : 0);
  Document().UpdateAllViews(nullptr, hintNumber, &argument);
}

}  // namespace tessal
