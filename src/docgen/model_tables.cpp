#include "docgen/model_tables.h"

#include <algorithm>
#include <span>
#include <utility>

#include "analysis/process_matrix.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "platform/ascii.h"
#include "platform/text_encoding.h"

namespace tessal {

namespace {

/// Where the cells of a column come from.
enum class CellSource : std::uint8_t { Symbol, Kind, Class, Field, Expression, Part };

struct ColumnRow {
  std::string_view name;
  CellSource source;
  CellKind kind;
  std::string_view label{};  ///< of the field
};

constexpr ColumnRow kSymbol{"Symbol", CellSource::Symbol, CellKind::Symbol};
constexpr ColumnRow kDescription{"Description", CellSource::Field, CellKind::Text, "Description"};
constexpr ColumnRow kUnit{"Unit", CellSource::Field, CellKind::Text, "Unit"};
constexpr ColumnRow kValue{"Value", CellSource::Field, CellKind::Number, "Default Value"};
constexpr ColumnRow kMinimum{"Minimum", CellSource::Field, CellKind::Number, "Min Value"};
constexpr ColumnRow kMaximum{"Maximum", CellSource::Field, CellKind::Number, "Max Value"};
// Modellers cite in the documentation of a value where it is from.
constexpr ColumnRow kSource{"Source", CellSource::Field, CellKind::Text, "Documentation"};
constexpr ColumnRow kClass{"Class", CellSource::Class, CellKind::Symbol};
constexpr ColumnRow kExpression{"Expression", CellSource::Expression, CellKind::Expression};

constexpr ColumnRow kValueColumns[] = {kSymbol,  kDescription, kValue, kMinimum,
                                       kMaximum, kUnit,        kClass, kSource};
constexpr ColumnRow kExpressionColumns[] = {kSymbol, kDescription, kExpression, kUnit, kClass};
constexpr ColumnRow kProcessColumns[] = {
    kSymbol, kDescription, kExpression, kUnit, {"Type", CellSource::Field, CellKind::Text, "Process type"}};
constexpr ColumnRow kMovementColumns[] = {{"Movement", CellSource::Symbol, CellKind::Text},
                                          {"Part", CellSource::Part, CellKind::Text},
                                          kExpression,
                                          kClass};
constexpr ColumnRow kOutputColumns[] = {
    {"Output", CellSource::Symbol, CellKind::Text}, kDescription, kExpression, kUnit};
constexpr ColumnRow kEquationColumns[] = {
    kSymbol, {"Equation", CellSource::Expression, CellKind::Derivative}, kClass};
constexpr ColumnRow kNomenclatureColumns[] = {kSymbol,
                                              {"Meaning", CellSource::Field, CellKind::Text, "Description"},
                                              kUnit,
                                              {"Kind", CellSource::Kind, CellKind::Text},
                                              kClass};

constexpr ElementKind kStates[] = {ElementKind::StateVariable, ElementKind::SpecieStateVariable};
constexpr ElementKind kParameters[] = {ElementKind::Constant, ElementKind::SpecieConstant};
constexpr ElementKind kForcings[] = {ElementKind::Forcing, ElementKind::SpecieForcing};
constexpr ElementKind kAuxiliaries[] = {ElementKind::Auxiliary};
constexpr ElementKind kProcesses[] = {ElementKind::Process};
constexpr ElementKind kClassExpressions[] = {ElementKind::ArithmeticExpression};
constexpr ElementKind kMovements[] = {ElementKind::HorizontalVector, ElementKind::VerticalEquation};
constexpr ElementKind kOutputs[] = {ElementKind::DerivedOutput};
constexpr ElementKind kNamed[] = {ElementKind::StateVariable,
                                  ElementKind::Constant,
                                  ElementKind::Forcing,
                                  ElementKind::Auxiliary,
                                  ElementKind::Process,
                                  ElementKind::Specie,
                                  ElementKind::SpecieStateVariable,
                                  ElementKind::SpecieConstant,
                                  ElementKind::SpecieForcing,
                                  ElementKind::SpatialFunction,
                                  ElementKind::ArithmeticExpression};

struct TableRow {
  std::string_view name;
  std::string_view title;
  std::span<const ElementKind> kinds;
  std::span<const ColumnRow> columns;
};

constexpr TableRow kTables[] = {
    {"states", "State variables", kStates, kValueColumns},
    {"parameters", "Parameters", kParameters, kValueColumns},
    {"forcings", "Forcings", kForcings, kValueColumns},
    {"auxiliaries", "Auxiliaries", kAuxiliaries, kExpressionColumns},
    {"processes", "Processes", kProcesses, kProcessColumns},
    {"class-expressions", "Expressions of particle classes", kClassExpressions, kExpressionColumns},
    {"movements", "Movements of particles", kMovements, kMovementColumns},
    {"equations", "Equations", kStates, kEquationColumns},
    {"outputs", "Derived outputs", kOutputs, kOutputColumns},
};
constexpr TableRow kNomenclature{"nomenclature", "Nomenclature", kNamed, kNomenclatureColumns};

/// A text of the template in UTF-8, with one blank in the place of each run of blanks and line ends.
std::string CellText(std::string_view text) {
  std::string cell;
  bool isGap = false;
  for (const char character : ToUtf8(text)) {
    const auto byte = static_cast<unsigned char>(character);
    constexpr unsigned char kDelete = 0x7F;
    if (byte <= ' ' || byte == kDelete) {
      isGap = true;
      continue;
    }
    if (isGap && !cell.empty()) cell += ' ';
    isGap = false;
    cell += character;
  }
  return cell;
}

class TableBuilder final {
 public:
  explicit TableBuilder(const TemplateCore& described) : core(described) {}

  ModelTable Build(const TableRow& row) const {
    ModelTable table{std::string(row.name), std::string(row.title), {}, {}, {}};
    for (const ColumnRow& column : row.columns) {
      table.columns.push_back({std::string(column.name), column.kind});
    }
    for (const SymbolRecord& record : core.SymbolTable()) {
      if (std::find(row.kinds.begin(), row.kinds.end(), record.element->Kind()) == row.kinds.end()) continue;
      std::vector<std::string> cells;
      for (const ColumnRow& column : row.columns) cells.push_back(CellOf(record, column));
      table.rows.push_back(std::move(cells));
    }
    return table;
  }

 private:
  std::string CellOf(const SymbolRecord& record, const ColumnRow& column) const {
    switch (column.source) {
      case CellSource::Symbol:
        return CellText(core.RecordSymbol(record));
      case CellSource::Kind:
        return std::string(record.element->KindText());
      case CellSource::Class:
        return record.specieIndex < 0 ? "" : CellText(ClassOf(core.Elements(), record).symbol.Text());
      case CellSource::Expression:
        return record.expression == nullptr ? "" : CellText(StripExpressionQuotes(record.expression->Text()));
      case CellSource::Part:
        return record.expression == nullptr ? "" : CellText(record.element->LabelOf(*record.expression));
      default:
        return FieldOf(*record.element, column.label);
    }
  }

  static std::string FieldOf(const CEL_Element& element, std::string_view label) {
    const PropertyPlace place = element.PlaceWithLabel(label);
    return place == nullptr ? "" : CellText((element.*place).TextOf());
  }

  const TemplateCore& core;
};

ModelTable MatrixTable(const ProcessMatrix& matrix, std::string name, std::string title) {
  ModelTable table{std::move(name), std::move(title), {{"Process", CellKind::Symbol}}, {}, {}};
  for (const MatrixElement& state : matrix.states) {
    table.columns.push_back({CellText(state.symbol), CellKind::Expression, true});
  }
  for (const MatrixRow& row : matrix.rows) {
    std::vector<std::string> cells(table.columns.size());
    cells.front() = CellText(row.process.symbol);
    for (const MatrixCell& cell : row.cells) cells[cell.column + 1] = CellText(cell.factor);
    table.rows.push_back(std::move(cells));
  }
  for (std::size_t column = 0; column < matrix.other.size(); ++column) {
    if (matrix.other[column].empty()) continue;
    table.notes.push_back("The equation of " + table.columns[column + 1].name +
                          " has besides: " + CellText(matrix.other[column]));
  }
  for (const MatrixFault& fault : matrix.faults) {
    table.notes.push_back("The equation of " + table.columns[fault.column + 1].name +
                          " is in no row: " + CellText(fault.reason));
  }
  return table;
}

/// Sorts by the symbols in the first column, as an index does.
void SortBySymbol(ModelTable& table) {
  std::stable_sort(table.rows.begin(), table.rows.end(), [](const auto& left, const auto& right) {
    return UpperCase(left.front()) < UpperCase(right.front());
  });
}

}  // namespace

std::vector<ModelTable> BuildModelTables(const TemplateCore& core) {
  const TableBuilder builder(core);
  std::vector<ModelTable> tables;
  for (const TableRow& row : kTables) tables.push_back(builder.Build(row));
  constexpr MatrixProcesses kAsWritten = MatrixProcesses::AsWritten;
  tables.push_back(MatrixTable(BuildProcessMatrix(core, kAsWritten), "matrix", "Process matrix"));
  for (const auto& specie : core.Species()) {
    const std::string name = CellText(specie->symbol.Text());
    tables.push_back(MatrixTable(BuildProcessMatrix(core, *specie, kAsWritten), "matrix-" + name,
                                 "Process matrix of " + name));
  }
  tables.push_back(builder.Build(kNomenclature));
  SortBySymbol(tables.back());
  return tables;
}

}  // namespace tessal
