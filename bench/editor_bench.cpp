// What a modeller sees of the editor's speed: a template opened until its window is painted, and one commit
// of a form with the messages that follow it. On the platform without a screen.
#include <benchmark/benchmark.h>

#include <QApplication>
#include <QKeyEvent>
#include <QLineEdit>
#include <QPixmap>
#include <memory>
#include <stdexcept>

#include "core/document.h"
#include "core/expression_faults.h"
#include "generated_template.h"
#include "ui/dialogs.h"
#include "ui/element_tree.h"
#include "ui/expression_field.h"
#include "ui/find_tools.h"
#include "ui/main_view.h"
#include "ui/right_pane.h"
#include "ui/tree_filter.h"

namespace {

using namespace tessal;
using bench::FileOfSize;
using bench::ScratchFolder;

constexpr QSize kScreen(1100, 760);

struct OpenEditor {
  explicit OpenEditor(const std::string& path) : document(ScreenDialogs()) {
    if (!document.OnOpenDocument(path)) throw std::runtime_error("no template");
    view = std::make_unique<CMainView>(document, ScreenDialogs());
    document.AddView(*view);
    view->OnInitialUpdate();
    view->resize(kScreen);
    view->show();
  }

  CTessalDoc document;
  std::unique_ptr<CMainView> view;
};

void FirstPaint(benchmark::State& state) {
  const ScratchFolder folder;
  const std::string path = FileOfSize(folder, state.range(0));
  for ([[maybe_unused]] auto iteration : state) {
    const OpenEditor editor(path);
    benchmark::DoNotOptimize(editor.view->grab().width());
  }
}
BENCHMARK(FirstPaint)->Arg(500)->Arg(5'000)->Arg(10'000)->Arg(50'000)->Unit(benchmark::kMillisecond);

/// The same of a template that is loaded already: the view is made, filled and painted.
void PaintLoaded(benchmark::State& state) {
  const ScratchFolder folder;
  CTessalDoc document(ScreenDialogs());
  if (!document.OnOpenDocument(FileOfSize(folder, state.range(0)))) throw std::runtime_error("no template");
  for ([[maybe_unused]] auto iteration : state) {
    CMainView view(document, ScreenDialogs());
    document.AddView(view);
    view.OnInitialUpdate();
    view.resize(kScreen);
    view.show();
    benchmark::DoNotOptimize(view.grab().width());
  }
}
BENCHMARK(PaintLoaded)->Arg(1'000)->Arg(10'000)->Arg(100'000)->Unit(benchmark::kMillisecond);

/// Selects an element and commits a changed field of its form over and over.
void CommitIn(benchmark::State& state, Uid (*uidOf)(TemplateCore& core)) {
  const ScratchFolder folder;
  const OpenEditor editor(FileOfSize(folder, state.range(0)));
  editor.view->SelectById(uidOf(editor.view->Document().Core()));
  auto* field = editor.view->Form()->findChild<QLineEdit*>("1079");
  int turn = 0;
  for ([[maybe_unused]] auto iteration : state) {
    field->setText(QString::number(++turn));
    editor.view->OnCommit();
  }
}

Uid MiddleProcess(TemplateCore& core) {
  return core.GetProcess(core.GetProcessCount() / 2).GetUid();
}

Uid FirstConstant(TemplateCore& core) {
  return core.GetConstant(0).GetUid();
}

BENCHMARK_CAPTURE(CommitIn, process, MiddleProcess)
    ->Arg(500)
    ->Arg(5'000)
    ->Arg(50'000)
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(CommitIn, constant, FirstConstant)->Arg(5'000)->Unit(benchmark::kMillisecond);

/// Selects one process and another: the commit of the form that is left, and the form that is opened and
/// painted.
void Selection(benchmark::State& state) {
  const ScratchFolder folder;
  const OpenEditor editor(FileOfSize(folder, state.range(0)));
  const TemplateCore& core = editor.view->Document().Core();
  std::size_t turn = core.GetProcessCount() / 2;
  for ([[maybe_unused]] auto iteration : state) {
    editor.view->SelectById(core.GetProcess(turn ^= 1U).GetUid());
    QCoreApplication::processEvents();
    benchmark::DoNotOptimize(editor.view->Form()->grab().width());
  }
}
BENCHMARK(Selection)->Arg(500)->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond);

/// A letter typed into an expression, with the list of completions, the marks and the formula that follow it.
/// The list is closed and the letter taken back unmeasured.
void KeyInExpression(benchmark::State& state) {
  const ScratchFolder folder;
  const OpenEditor editor(FileOfSize(folder, state.range(0)));
  const TemplateCore& core = editor.view->Document().Core();
  editor.view->SelectById(core.GetProcess(core.GetProcessCount() - 1).GetUid());
  auto* field = editor.view->Form()->findChild<CAutoRichEditCtrl*>("1115");
  field->setFocus();
  field->setPlainText(field->toPlainText() + QStringLiteral("+p"));
  field->moveCursor(QTextCursor::End);
  QKeyEvent letter(QEvent::KeyPress, Qt::Key_R, Qt::NoModifier, QStringLiteral("r"));
  for ([[maybe_unused]] auto iteration : state) {
    QApplication::sendEvent(field, &letter);
    QCoreApplication::processEvents();
    state.PauseTiming();
    if (QWidget* list = QApplication::activePopupWidget()) list->close();
    field->textCursor().deletePreviousChar();
    QCoreApplication::processEvents();
    state.ResumeTiming();
  }
}
BENCHMARK(KeyInExpression)->Arg(500)->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond);

/// What is looked for when typing pauses.
void FaultsOfExpression(benchmark::State& state) {
  const ScratchFolder folder;
  const OpenEditor editor(FileOfSize(folder, state.range(0)));
  const TemplateCore& core = editor.view->Document().Core();
  const CEL_Process& process = core.GetProcess(core.GetProcessCount() - 1);
  const std::string text = process.expression.TextOf() + "+nobody+proces_1";
  for ([[maybe_unused]] auto iteration : state)
    benchmark::DoNotOptimize(FindExpressionFaults(core, process, text).size());
}
BENCHMARK(FaultsOfExpression)->Arg(500)->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond);

/// Selects the folder of many constants, and the root again; the time of the folder alone counts.
void FolderSelection(benchmark::State& state) {
  const ScratchFolder folder;
  const OpenEditor editor(bench::FileOfConstants(folder, static_cast<int>(state.range(0))));
  for ([[maybe_unused]] auto iteration : state) {
    editor.view->SelectById(folder_id::kConstants);
    QCoreApplication::processEvents();
    benchmark::DoNotOptimize(editor.view->Form()->grab().width());
    state.PauseTiming();
    editor.view->SelectById(folder_id::kForcings);
    QCoreApplication::processEvents();
    state.ResumeTiming();
  }
}
BENCHMARK(FolderSelection)->Arg(1'000)->Arg(10'000)->Arg(100'000)->Unit(benchmark::kMillisecond);

/// Types a letter into the filter over the tree, and takes it away again; then both are painted.
void TreeFilter(benchmark::State& state, const char* text) {
  const ScratchFolder folder;
  const OpenEditor editor(FileOfSize(folder, state.range(0)));
  auto* line = editor.view->FindTools().TreeFilter().findChild<QLineEdit*>();
  for ([[maybe_unused]] auto iteration : state) {
    line->setText(QString::fromLatin1(text));
    QCoreApplication::processEvents();
    benchmark::DoNotOptimize(editor.view->grab().width());
    state.PauseTiming();
    line->clear();
    QCoreApplication::processEvents();
    state.ResumeTiming();
  }
}
BENCHMARK_CAPTURE(TreeFilter, some, "constant17")->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(TreeFilter, most, "s")->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond);

/// The same for taking the text away.
void TreeFilterCleared(benchmark::State& state) {
  const ScratchFolder folder;
  const OpenEditor editor(FileOfSize(folder, state.range(0)));
  auto* line = editor.view->FindTools().TreeFilter().findChild<QLineEdit*>();
  for ([[maybe_unused]] auto iteration : state) {
    state.PauseTiming();
    line->setText(QStringLiteral("constant17"));
    QCoreApplication::processEvents();
    state.ResumeTiming();
    line->clear();
    QCoreApplication::processEvents();
    benchmark::DoNotOptimize(editor.view->grab().width());
  }
}
BENCHMARK(TreeFilterCleared)->Arg(5'000)->Arg(50'000)->Unit(benchmark::kMillisecond);

}  // namespace

int main(int count, char** arguments) {
  qputenv("QT_QPA_PLATFORM", "offscreen");
  const QApplication application(count, arguments);
  benchmark::Initialize(&count, arguments);
  benchmark::RunSpecifiedBenchmarks();
  return 0;
}
