// The structural pass over a template: it numbers the elements and makes the flat symbol table anew. It holds
// nothing between runs and reports nothing.

#include "core/scope_rule.h"
#include "core/template_core.h"
#include "platform/number_text.h"

namespace tessal {

void TemplateCore::RebuildSymbolTable() {
  if (!flags.rebuildEnabled) return;
  const NotificationsOff silent;
  MarkUndefinedStale();
  ResolveReferencesToNames();
  recordCount = 0;
  NumberTemplateElements();
  NumberParticleElements();
  symbolTable.resize(recordCount);
  ExtractReferences();
  BuildReverseReferences();
  ClassifyArithmeticExpressions();
  ResolveNamesToReferences();
  DropStaleUndefined();
}

void TemplateCore::MarkUndefinedStale() {
  for (const auto& undefined : undefinedSymbols) {
    undefined->stale = true;
    undefined->usedBy.clear();
  }
}

void TemplateCore::DropStaleUndefined() {
  std::erase_if(undefinedSymbols, [](const auto& undefined) { return undefined->stale; });
}

SymbolRecord& TemplateCore::AppendRecord(CEL_Element& element, std::int32_t index, std::int32_t specieIndex,
                                         std::string_view text) {
  // A record is made anew in the place of the one before the rebuild, whose buffers it takes over.
  if (recordCount == symbolTable.size()) symbolTable.emplace_back();
  SymbolRecord& record = symbolTable[recordCount];
  ++recordCount;
  record.sequence = static_cast<std::uint32_t>(recordCount);
  const SymbolRecord* before = recordCount < 2 ? nullptr : &symbolTable[recordCount - 2];
  record.scope = before == nullptr ? scope_code::kGlobal : before->scope;
  record.spatial = before == nullptr ? spatial_code::kNone : before->spatial;
  record.index = index;
  record.specieIndex = specieIndex;
  record.text = text;
  for (auto* list : {&record.references, &record.referencedBy}) list->clear();
  for (auto* list : {&record.referenceUids, &record.referencedByUids}) list->clear();
  record.element = &element;
  record.uid = element.GetUid();
  element.id.SetInt(static_cast<std::int32_t>(record.sequence));
  return record;
}

void TemplateCore::NumberTemplateElements() {
  const auto append = [this](auto& element, std::int32_t index, std::string_view text) -> SymbolRecord& {
    SymbolRecord& record = AppendRecord(element, index, -1, text);
    record.scope = ScopeFromText(element.scope.Text());
    return record;
  };
  const auto appendVarying = [&append](auto& element, std::int32_t index, std::string_view text) {
    append(element, index, text).spatial = SpatialFromText(element.spatialVariation.Text());
  };
  std::int32_t index = 0;
  for (const auto& element : stateVariables) {
    SymbolRecord& record = append(*element, index++, element->equation.Text());
    record.spatial = SpatialFromScope(record.scope);
  }
  const auto appendInputs = [&appendVarying](const auto& inputs) {
    std::int32_t place = 0;
    for (const auto& element : inputs) {
      appendVarying(*element, place++, SixDigitNumberText(element->defaultValue.RealValue()));
    }
  };
  const auto appendExpressions = [&appendVarying](const auto& elements) {
    std::int32_t place = 0;
    for (const auto& element : elements) appendVarying(*element, place++, element->expression.Text());
  };
  appendInputs(constants);
  appendInputs(forcings);
  appendExpressions(auxiliaries);
  appendExpressions(processes);
  appendExpressions(derivedOutputs);
}

void TemplateCore::NumberParticleElements() {
  const auto append = [this](const auto& members, std::size_t specie, auto textOf) {
    std::int32_t place = 0;
    for (const auto& member : members) {
      AppendRecord(*member, place++, static_cast<std::int32_t>(specie), textOf(*member));
    }
  };
  const auto valueText = [](const CEL_SpecieValue& member) {
    return SixDigitNumberText(member.defaultValue.RealValue());
  };
  for (std::size_t place = 0; place < species.size(); ++place) {
    const CEL_Lagrange_Specie& specie = *species[place];
    append(specie.stateVariables, place,
           [](const auto& member) -> const std::string& { return member.equation.Text(); });
    append(specie.constants, place, valueText);
    append(specie.forcings, place, valueText);
    append(specie.spatialFunctions, place,
           [](const auto& member) -> const std::string& { return member.VariableName(); });
    append(specie.arithmeticExpressions, place,
           [](const auto& member) -> const std::string& { return member.expression.Text(); });
  }
  for (std::size_t place = 0; place < species.size(); ++place) {
    CEL_Lagrange_Specie& specie = *species[place];
    const auto specieIndex = static_cast<std::int32_t>(place);
    AppendRecord(specie, specieIndex, specieIndex, "");
    std::int32_t index = 0;
    for (const auto& vector : specie.horizontalVectors) {
      AppendRecord(*vector, index, specieIndex, vector->direction.Text());
      AppendRecord(*vector, index, specieIndex, vector->speed.Text());
      ++index;
    }
    AppendRecord(*specie.verticalEquation, 0, specieIndex, specie.verticalEquation->speed.Text());
  }
}

}  // namespace tessal
