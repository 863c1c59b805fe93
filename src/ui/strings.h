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

// The commands of the edit menu. The names of steps follow "Undo" and "Redo".
inline constexpr const char* kEditMenu = "&Edit";
inline constexpr const char* kViewMenu = "&View";
inline constexpr const char* kGoMenu = "&Go";
inline constexpr const char* kAnalysisMenu = "Anal&ysis";
inline constexpr const char* kHelpMenu = "&Help";
inline const QString kZoomIn = QStringLiteral("&Larger Texts");
inline const QString kZoomOut = QStringLiteral("&Smaller Texts");
inline const QString kZoomUsual = QStringLiteral("&Usual Size of Texts");
inline const QString kContents = QStringLiteral("&Contents");
inline constexpr const char* kGuide = "&Guide";
inline constexpr const char* kFunctions = "&Functions";
inline const QString kUndo = QStringLiteral("&Undo");
inline const QString kRedo = QStringLiteral("&Redo");
inline const QString kCut = QStringLiteral("Cu&t");
inline const QString kCopy = QStringLiteral("&Copy");
inline const QString kPaste = QStringLiteral("&Paste");
inline const QString kDuplicate = QStringLiteral("Dup&licate");
inline const QString kNewElement = QStringLiteral("&New Element");
inline const QString kDeleteElement = QStringLiteral("&Delete");
inline const QString kRenameElement = QStringLiteral("Rena&me");
inline const QString kMoveElementUp = QStringLiteral("Move &Up");
inline const QString kMoveElementDown = QStringLiteral("Move Do&wn");
inline const QString kOneMessage = QStringLiteral("1 message");
inline const QString kMessageCount = QStringLiteral("%1 messages");
inline const QString kCaretPlace = QStringLiteral("Line %1, column %2");
inline const QString kStatusGap = QStringLiteral("    ");
inline const QString kEditing = QStringLiteral("Editing");
inline const QString kUndone = QStringLiteral("Undone: %1");
inline const QString kRedone = QStringLiteral("Done again: %1");
inline const QString kStillUsed = QStringLiteral("Not deleted, because others use them: %1");
inline const QString kNotMoved =
    QStringLiteral("Not moved, because a use would come before its definition: %1");
inline const QString kCopied = QStringLiteral("Copied: %1");
inline const QString kPasted = QStringLiteral("Pasted: %1");
inline const QString kElementCount = QStringLiteral("%1 elements");
inline const QString kOneElement = QStringLiteral("1 element");

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

// Finding, replacing and going to places.
inline const QString kFilterTree = QStringLiteral("Filter by symbol, description or unit");
inline const QString kNoMatch = QStringLiteral("none");
inline const QString kMatchCount = QStringLiteral("%1 found");
inline const QString kMatchOf = QStringLiteral("%1 of %2");
inline const QString kFindInTemplate = QStringLiteral("Find in Template");
inline const QString kFindPattern = QStringLiteral("Find");
inline const QString kFindAll = QStringLiteral("Find All");
inline const QString kCloseFind = QStringLiteral("Close");
inline const QString kReplaceWith = QStringLiteral("Replace with");
inline const QString kPreview = QStringLiteral("Preview");
inline const QString kReplaceChosen = QStringLiteral("Replace Ticked");
inline const QString kFindWhere = QStringLiteral("Where to find");
inline const QString kInAll = QStringLiteral("in all");
inline const QString kInExpressions = QStringLiteral("in expressions");
inline const QString kInTexts = QStringLiteral("in texts");
inline const QString kMatchCase = QStringLiteral("Match case");
inline const QString kWholeSymbols = QStringLiteral("Whole symbols");
inline const QString kRegex = QStringLiteral("Regular expression");
inline const QString kFoundList = QStringLiteral("Found places");
inline const QString kNothingFound = QStringLiteral("Nothing was found.");
inline const QString kOneMatch = QStringLiteral("1 match");
inline const QString kFoundMatches = QStringLiteral("%1 matches in %2 texts");
inline const QString kOneUse = QStringLiteral("1 use of '%1'");
inline const QString kFoundUses = QStringLiteral("Uses of '%1': %2 in %3 expressions");
inline const QString kPreviewCount =
    QStringLiteral("%1 texts match. Those that are ticked will be replaced.");
inline const QString kReplaced = QStringLiteral("Texts replaced: %1");
inline const QString kReplacedSome = QStringLiteral("Texts replaced: %1, refused: %2");
inline const QString kSymbolStays = QStringLiteral("A symbol: rename it, so that its uses follow.");
inline const QString kLockedStays = QStringLiteral("Locked: its built-in variable or unit type decides.");
inline const QString kElementColumn = QStringLiteral("Element");
inline const QString kFieldColumn = QStringLiteral("Field");
inline const QString kTextColumn = QStringLiteral("Text");
inline const QString kAfterColumn = QStringLiteral("Becomes");
inline const QString kGoToSymbol = QStringLiteral("Go to Symbol");
inline const QString kSymbolLetters = QStringLiteral("Letters of the symbol");
inline const QString kFittingSymbols = QStringLiteral("Symbols that fit");
inline const QString kCommandFilter = QStringLiteral("&Filter Tree");
inline const QString kCommandFind = QStringLiteral("Find in &Template...");
inline const QString kCommandNextMatch = QStringLiteral("&Next Match");
inline const QString kCommandFormerMatch = QStringLiteral("&Previous Match");
inline const QString kCommandGoTo = QStringLiteral("Go to &Symbol...");
inline const QString kCommandUses = QStringLiteral("Find &Uses");
inline const QString kCommandNextMessage = QStringLiteral("&Next Message");
inline const QString kCommandFormerMessage = QStringLiteral("&Previous Message");

// The bar and the menu of the list of messages.
inline const QString kOneError = QStringLiteral("%1 Error");
inline const QString kErrors = QStringLiteral("%1 Errors");
inline const QString kOneWarning = QStringLiteral("%1 Warning");
inline const QString kWarnings = QStringLiteral("%1 Warnings");
inline const QString kOneNotice = QStringLiteral("%1 Notice");
inline const QString kNotices = QStringLiteral("%1 Notices");
inline const QString kFilterMessages = QStringLiteral("Filter messages");
inline const QString kExplain = QStringLiteral("&Explain");
inline const QString kExplanation = QStringLiteral("What the Message Means");
inline const QString kCopyRows = QStringLiteral("Co&py");
inline const QString kSortByItem = QStringLiteral("Sort by &Item");
inline const QString kSortByMessage = QStringLiteral("Sort by &Message");
inline const QString kUsualOrder = QStringLiteral("Usual &Order");

// The analyses.
inline const QString kCommandAnalyse = QStringLiteral("&Analyse");
inline const QString kCommandMatrix = QStringLiteral("Process &Matrix");
inline const QString kCommandPools = QStringLiteral("&Pools");
inline const QString kCommandInfluences = QStringLiteral("&Influences");
inline const QString kCommandUp = QStringLiteral("&What Influences This");
inline const QString kCommandDown = QStringLiteral("What &Does This Influence");
inline const QString kAnalyses = QStringLiteral("Analyses");
inline const QString kCloseAnalyses = QStringLiteral("Close the analyses");

inline const QString kFindingsPage = QStringLiteral("Findings");
inline const QString kFindingList = QStringLiteral("Findings of the analyses");
inline const QString kAnalyse = QStringLiteral("Analyse");
inline const QString kExplainFinding = QStringLiteral("Explain");
inline const QString kSymbolColumn = QStringLiteral("Symbol");
inline const QString kRuleColumn = QStringLiteral("Rule");
inline const QString kOneFinding = QStringLiteral("1 finding");
inline const QString kFindingCount = QStringLiteral("%1 findings");

inline const QString kMatrixPage = QStringLiteral("Process Matrix");
inline const QString kMatrixTable = QStringLiteral("Table of the process matrix");
inline const QString kMatrixOf = QStringLiteral("Matrix of");
inline const QString kWholeTemplate = QStringLiteral("the template");
inline const QString kMatrixProcesses = QStringLiteral("Processes");
inline const QString kAsWritten = QStringLiteral("as written");
inline const QString kElementary = QStringLiteral("elementary");
inline const QString kRateColumn = QStringLiteral("Rate");
inline const QString kOtherRow = QStringLiteral("Other");
inline const QString kEmptyCell = QStringLiteral("empty");
inline const QString kMatrixSize = QStringLiteral("Processes: %1, state variables: %2");
inline const QString kNotInMatrix = QStringLiteral("Not in the matrix: %1");
inline const QString kGoToState = QStringLiteral("Go to State &Variable");
inline const QString kGoToProcess = QStringLiteral("Go to &Process");

inline const QString kPoolsPage = QStringLiteral("Pools");
inline const QString kPoolList = QStringLiteral("Pools of the template");
inline const QString kAddPool = QStringLiteral("Add Pool");
inline const QString kRemovePool = QStringLiteral("Remove Pool");
inline const QString kPoolName = QStringLiteral("Pool name");
inline const QString kPoolExpression = QStringLiteral("Pool expression");
inline const QString kPoolBoundary = QStringLiteral("Boundary processes");
inline const QString kPoolDescription = QStringLiteral("Pool description");
inline const QString kPoolColumn = QStringLiteral("Pool");
inline const QString kVerdictColumn = QStringLiteral("Verdict");
inline const QString kClosedPool = QStringLiteral("closed");
inline const QString kOpenPool = QStringLiteral("open");
inline const QString kUnknownPool = QStringLiteral("unknown: %1");
inline const QString kLeakList = QStringLiteral("Leaks of the pool");
inline const QString kProcessColumn = QStringLiteral("Process");
inline const QString kNetColumn = QStringLiteral("Net yield");
inline const QString kValueColumn = QStringLiteral("At default values");
inline const QString kNoProcess = QStringLiteral("no process");
inline const QString kNewPool = QStringLiteral("pool_%1");
inline const QString kPoolsNotRead = QStringLiteral("Not read: %1");
inline const QString kPoolsNotKept = QStringLiteral("Not changed: %1");
inline constexpr const char* kStepAddPool = "Add pool ";
inline constexpr const char* kStepRemovePool = "Remove pool ";
inline constexpr const char* kStepChangePool = "Change pool ";

inline const QString kInfluencesPage = QStringLiteral("Influences");
inline const QString kInfluenceDrawing = QStringLiteral("Drawing of the influences");
inline const QString kInfluenceList = QStringLiteral("List of the influences");
inline const QString kInfluenceSteps = QStringLiteral("Steps");
inline const QString kInfluenceDirection = QStringLiteral("Direction");
inline const QString kBothDirections = QStringLiteral("both");
inline const QString kUpwards = QStringLiteral("what influences this");
inline const QString kDownwards = QStringLiteral("what this influences");
inline const QString kMainKinds = QStringLiteral("State variables and processes only");
inline const QString kRelationColumn = QStringLiteral("Relation");
inline const QString kUnitColumn = QStringLiteral("Unit");
inline const QString kThisElement = QStringLiteral("this element");
inline const QString kInfluencesThis = QStringLiteral("influences this");
inline const QString kInfluencesInSteps = QStringLiteral("influences this in %1 steps");
inline const QString kInfluencedByThis = QStringLiteral("is influenced by this");
inline const QString kInfluencedInSteps = QStringLiteral("is influenced by this in %1 steps");
inline const QString kInfluencesOf = QStringLiteral("%1: influenced by %2, influences %3");
inline const QString kNotDrawn = QStringLiteral("%1 more are in the list and not drawn");
inline const QString kNoElement = QStringLiteral("Select an element with a symbol to see its influences.");

inline const QString kUnitOfExpression = QStringLiteral("expression: %1");
inline const QString kUnitDiffers = QStringLiteral("expression differs: %1");

}  // namespace tessal::strings
