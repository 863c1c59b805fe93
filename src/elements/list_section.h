// Sections of a file that hold a list: a sub-section for each element, named by a prefix and its place
// from 1. Read by position, whatever the names.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "elements/element.h"
#include "elements/property_io.h"
#include "elements/sequence.h"

namespace tessal {

/// Reads the section of that name, if there is one: the texts of the list head, if it has one, then an
/// element made by `add` for each sub-section.
template <class AddElement>
void ReadList(KvfNode parent, std::string_view name, CEL_Element* head, ReadStatus& status, AddElement add) {
  const KvfNode list = kvfSectionByNameNum(parent, name, 1);
  if (list == nullptr) return;
  if (head != nullptr) head->Read(list, status);
  for (KvfNode section = kvfFirstSection(list); section != nullptr; section = kvfNextSection(section, list)) {
    CEL_Element& element = add();
    element.Read(section, status);
    element.SetLoaded(true);
  }
}

/// Writes a section of that name with the head's texts and the elements, each by `write(element)`.
template <class Elements, class WriteElement>
void WriteList(const Elements& elements, std::string_view name, std::string_view prefix, CEL_Element* head,
               KvfHandle file, int& status, WriteElement write) {
  kvfAddSection(file, name);
  if (head != nullptr) head->Write(file, status);
  std::size_t place = 0;
  for (const auto& element : elements) {
    kvfAddSection(file, std::string(prefix) + std::to_string(++place));
    write(*element);
    kvfEndSection(file);
  }
  kvfEndSection(file);
}

template <class Elements>
void WriteList(const Elements& elements, std::string_view name, std::string_view prefix, CEL_Element* head,
               KvfHandle file, int& status) {
  WriteList(elements, name, prefix, head, file, status,
            [file, &status](auto& element) { element.Write(file, status); });
}

/// Equations lie in a section apart, in the order of their state variables, each under its symbol as keyword.
/// More sub-sections than state variables raise the subscript failure.
template <class StateVariables>
void ReadEquations(KvfNode equations, const StateVariables& stateVariables, ReadStatus& status) {
  std::size_t place = 0;
  for (KvfNode section = kvfFirstSection(equations); section != nullptr;
       section = kvfNextSection(section, equations)) {
    auto& variable = At(stateVariables, place++);
    status.Begin(variable, section);
    ReadProperty(variable.equation, section, variable.symbol.Text(), status);
    if (!HasKeyword(section, variable.symbol.Text())) status.NoteMisnamed(section, variable.equation);
  }
}

template <class StateVariables>
void WriteEquations(const StateVariables& stateVariables, std::string_view name, std::string_view prefix,
                    KvfHandle file, int& status) {
  WriteList(stateVariables, name, prefix, nullptr, file, status, [file, &status](auto& variable) {
    WriteProperty(variable.equation, file, variable.symbol.Text(), variable, status);
  });
}

}  // namespace tessal
