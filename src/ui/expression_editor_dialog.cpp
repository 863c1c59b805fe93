#include "ui/expression_editor_dialog.h"

#include <QDialogButtonBox>
#include <QGridLayout>
#include <QPushButton>
#include <QTextEdit>
#include <QTreeWidget>
#include <array>

#include "ui/child.h"
#include "ui/strings.h"

namespace tessal {

namespace {

/// The keys, row by row, with the numbers of their controls.
struct Key {
  int control;
  const char16_t* text;
};

constexpr int kKeysPerRow = 4;

constexpr std::array<Key, 33> kKeys = {{
    {1001, u"1"},    {1002, u"2"},    {1003, u"3"},    {1004, u"4"},
    {1005, u"5"},    {1006, u"6"},    {1007, u"7"},    {1008, u"8"},
    {1009, u"9"},    {1000, u"0"},    {1022, u"."},    {1020, u"/"},
    {1025, u"*"},    {1024, u"-"},    {1029, u"+"},    {1013, u"\u2039\u2039"},
    {1026, u"("},    {1015, u")"},    {1028, u"Pi"},   {1036, u"x?"},
    {1032, u"sin"},  {1037, u"tan"},  {1016, u"cos"},  {1035, u"V?"},
    {1018, u"x?"},   {1033, u"sinh"}, {1038, u"tanh"}, {1017, u"cosh"},
    {1030, u"^"},    {1027, u"%"},    {1011, u"asin"}, {1012, u"atan"},
    {1010, u"acos"},
}};

}  // namespace

CExpressionEditorDlg::CExpressionEditorDlg(QWidget* parent) : QDialog(parent) {
  setWindowTitle(strings::kExpressionEditor);
  auto* layout = MakeChild<QGridLayout>(this);
  auto* tree = MakeChild<QTreeWidget>(this);
  tree->setHeaderHidden(true);
  tree->setAccessibleName(QStringLiteral("Symbols"));
  auto* text = MakeChild<QTextEdit>(this);
  text->setAccessibleName(QStringLiteral("Expression"));
  text->setTabChangesFocus(true);
  auto* keys = MakeChild<QGridLayout>();
  QStringList texts;
  for (std::size_t place = 0; place < kKeys.size(); ++place) {
    const QString keyText = QString::fromUtf16(kKeys[place].text);
    auto* key = MakeChild<QPushButton>(keyText, this);
    texts.append(keyText);
    // Of two keys that look alike, who hears them knows which is which.
    const auto times = texts.count(keyText);
    if (times > 1) key->setAccessibleName(QStringLiteral("%1 (%2)").arg(keyText).arg(times));
    key->setObjectName(QString::number(kKeys[place].control));
    key->setAutoDefault(false);
    const int index = static_cast<int>(place);
    keys->addWidget(key, index / kKeysPerRow, index % kKeysPerRow);
  }
  auto* buttons = MakeChild<QDialogButtonBox>(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
  connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
  connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
  layout->addWidget(tree, 0, 0, 2, 1);
  layout->addWidget(text, 0, 1);
  layout->addLayout(keys, 1, 1);
  layout->addWidget(buttons, 2, 0, 1, 2);
}

}  // namespace tessal
