// The texts that the editor shows of its own.
#pragma once

#include <QString>
#include <array>

namespace tessal::strings {

inline const QString kEditorName = QStringLiteral("Tessal");
inline const QString kError = QStringLiteral("Error");
inline const QString kHelp = QStringLiteral("Tessal Help");

// The tool bars.
inline const QString kNavigateBack = QStringLiteral("Navigate back");
inline const QString kNavigateForward = QStringLiteral("Navigate forward");
inline const QString kNavigationHistory = QStringLiteral("Navigation history");

// The commands of the list pages.
inline const QString kNew = QStringLiteral("New");
inline const QString kEditRow = QStringLiteral("Edit");
inline const QString kMoveDown = QStringLiteral("Move down");
inline const QString kMoveUp = QStringLiteral("Move up");
inline const QString kListCommands = QStringLiteral("Commands of the list");
inline const QString kNumberColumn = QStringLiteral("No.");
inline const QString kDescriptionColumn = QStringLiteral("Description");
inline const QString kVisibilityGroup = QStringLiteral("Visibility group");
inline const QString kLevel = QStringLiteral("Level");
inline const QString kExpand = QStringLiteral("expand");

// The pages of the root.
inline const QString kPages = QStringLiteral("Pages");
inline const QString kGeneralPage = QStringLiteral("General");
inline const QString kOverviewPage = QStringLiteral("Overview");
inline const QString kEnableMisc = QStringLiteral("Enable miscellaneous features");
inline const QString kEnableParticles = QStringLiteral("Enable particle class/species");
inline const QString kShowAllBuiltIns = QStringLiteral("Show all built-in constants/forcing");
inline const QString kToClipboard = QStringLiteral("to clipboard");
inline constexpr const char* kClipboardDone = "Overview data exported to clipboard!";
inline const QString kExportHtml = QStringLiteral("export HTML");
inline const QString kAskMathJax = QStringLiteral(
    "Export template as HTML documentation.\n\nEmbedd MathJax (jscript MathML render) for equations ?");
inline const QString kPageExported = QStringLiteral("Template documentation exported to '%1'");

inline const QString kSafePage = QStringLiteral("&Markup and scripts in texts have no effect");

// The visibility pages.
inline const QString kDefinedLevels = QStringLiteral("Defined levels");
inline const QString kGroupName = QStringLiteral("Group Name:");
inline const QString kGroupDescription = QStringLiteral("Description:");
inline const QString kLevelName = QStringLiteral("Level name");
inline const QString kAvailableItems = QStringLiteral("Available items");
inline const QString kLevelDescription = QStringLiteral("Description of the level");
inline const QString kIncludedItems = QStringLiteral("Include items");
inline const QString kInclude = QStringLiteral("-->");
inline const QString kExclude = QStringLiteral("<--");
inline const QString kAddLevel = QStringLiteral("Add a level");
inline const QString kDeleteLevel = QStringLiteral("Delete the level");
inline const QString kIncludeItem = QStringLiteral("Include the item in the level");
inline const QString kExcludeItem = QStringLiteral("Take the item out of the level");

// Renames.
inline const QString kLongerNames = QStringLiteral("Longer names would change too (%1):");
inline const QString kMoreNames = QStringLiteral("and %1 more");
inline const QString kLeaveLongerNames = QStringLiteral("&Leave Longer Names Alone");

// The main view.
inline const QString kElements = QStringLiteral("Elements of the template");
inline const QString kMessages = QStringLiteral("Messages");
inline const QString kItemColumn = QStringLiteral("Item");
inline const QString kMessageColumn = QStringLiteral("Error message");
inline const QString kGeneric = QStringLiteral("generic");
inline const QString kUndefinedSymbol = QStringLiteral("Undefined symbol ");
inline const QString kCreateNew = QStringLiteral("Create new");
inline const QString kDelete = QStringLiteral("Delete");

// What a load did not take over from the file.
inline const QString kOneUnread = QStringLiteral("%1 value of this file could not be read.");
inline const QString kUnread = QStringLiteral("%1 values of this file could not be read.");
inline const QString kOneNotKept =
    QStringLiteral("%1 part of this file will not be kept as it is by a save.");
inline const QString kNotKept =
    QStringLiteral("%1 parts of this file will not be kept as they are by a save.");
inline const QString kDetails = QStringLiteral("De&tails");
inline const QString kReadThem = QStringLiteral("&Read Them");
inline const QString kAtLine = QStringLiteral("Line %1: %2");
inline const QString kAccountTitle = QStringLiteral("Not taken over from the file");
inline const QString kAskAboutLosses =
    QStringLiteral("The file '%1' holds what this save would lose or change:\n\n%2\n\nReplace it?");
inline const QString kMoreLosses = QStringLiteral("and %1 more");
inline const QString kReplace = QStringLiteral("&Replace");
inline const QString kSaveCopy = QStringLiteral("Save a &Copy...");

// The forms.
inline const QString kNoView = QStringLiteral("There is no view for current selectoin.");
inline constexpr const char* kNotUsed = "Not used !";
inline const QString kGeneralOverview = QStringLiteral("General overview");
inline const QString kBrowse = QStringLiteral("...");
inline const QString kView = QStringLiteral("view");
inline const QString kEdit = QStringLiteral("Edit...");
inline const QString kExpressionEditor = QStringLiteral("Expression Editor");
inline const QString kSelectDocumentation = QStringLiteral("Select documentation file");
inline const QString kOpenDocumentation = QStringLiteral("Open documentation");
inline const QString kDocumentationFilter =
    QStringLiteral("Portable data files (*.pdf);;Word documents (*.doc *.docx);;All files (*)");

// Expressions while they are typed. The groups are in the order of their enumeration.
inline const QString kInsert = QStringLiteral("Insert");
inline const QString kPalette = QStringLiteral("Operators and functions to insert");
inline const QString kPaletteOf = QStringLiteral("Insert into %1");
inline const QString kOperators = QStringLiteral("Operators");
inline const QString kFormulaOf = QStringLiteral("Formula of %1");
inline const QString kFormerFormula = QStringLiteral("The formula of the text before: %1");
inline const QString kFormulaTooLarge = QStringLiteral("too large to show");
inline const QString kCopyMathML = QStringLiteral("Copy as &MathML");
inline const QString kCopyLatex = QStringLiteral("Copy as &LaTeX");
inline const QString kCopyPicture = QStringLiteral("Copy as &Picture");
inline const QString kHideFormulas = QStringLiteral("&Hide Formulas");
inline const QString kCompletions = QStringLiteral("Completions");
inline const std::array<QString, 7> kCompletionGroups = {QStringLiteral("symbol"),
                                                         QStringLiteral("function"),
                                                         QStringLiteral("user function"),
                                                         QStringLiteral("interaction of particles"),
                                                         QStringLiteral("keyword"),
                                                         QStringLiteral("built-in, not in the template yet"),
                                                         QStringLiteral("property of a particle")};

// The creation dialog.
inline const QString kSkip = QStringLiteral("Skip");

// Exports.
inline const QString kExporting = QStringLiteral("Exporting to %1...");
inline const QString kNotExported = QStringLiteral("Failed to export to\n%1\n\n%2");
inline const QString kExported = QStringLiteral("Exported to\n%1\n\nOpen it?");
inline const QString kNotOpened = QStringLiteral("No program on this system opens\n%1");

// What a template names as its documentation.
inline const QString kAskOpenTarget =
    QStringLiteral("The template names what is no usual document. Open it?\n\n%1");
inline const QString kTargetRefused = QStringLiteral(
    "Only documents and addresses are opened. This is a program, can start one, or is no file:\n\n%1");

// The list of messages and the marks in the tree.
inline const QString kCreateSymbol = QStringLiteral("&Create symbol '%1'...");
inline const QString kHasMessages = QStringLiteral("%1 in the list of messages: %2");

}  // namespace tessal::strings
