// The texts that the editor shows of its own.
#pragma once

#include <QString>

namespace tessal::strings {

inline const QString kEditorName = QStringLiteral("Tessal");
inline const QString kSelectDocumentation = QStringLiteral("Select documentation file");
inline const QString kDocumentationFilter =
    QStringLiteral("Portable data files (*.pdf);;Word documents (*.doc *.docx);;All files (*)");
inline const QString kNoView = QStringLiteral("There is no view for current selectoin.");
inline const QString kNotUsed = QStringLiteral("Not used !");
inline const QString kCreateNew = QStringLiteral("Create new");
inline const QString kDelete = QStringLiteral("Delete");
inline const QString kNavigateBack = QStringLiteral("Navigate back");
inline const QString kNavigateForward = QStringLiteral("Navigate forward");
inline const QString kNavigationHistory = QStringLiteral("Navigation history");
inline const QString kItemColumn = QStringLiteral("Item");
inline const QString kMessageColumn = QStringLiteral("Error message");
inline const QString kGeneric = QStringLiteral("generic");
inline const QString kExpressionEditor = QStringLiteral("Expression Editor");
inline const QString kEdit = QStringLiteral("Edit...");
inline const QString kBrowse = QStringLiteral("...");
inline const QString kView = QStringLiteral("view");
inline const QString kError = QStringLiteral("Error");

}  // namespace tessal::strings
