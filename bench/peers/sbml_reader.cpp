// Reads an SBML file with libSBML and ends: the process that the tool's check is compared with. It ends
// without releasing the document, whose release is no part of a reading.
#include <sbml/SBMLTypes.h>

#include <cstdlib>
#include <iostream>

int main(int count, char** arguments) {
  if (count != 2) {
    std::cerr << "usage: sbml_reader FILE\n";
    return EXIT_FAILURE;
  }
  SBMLDocument* document = readSBMLFromFile(arguments[1]);
  if (document->getNumErrors() > 0 || document->getModel() == nullptr ||
      document->getModel()->getNumRules() == 0) {
    document->printErrors(std::cerr);
    std::cerr << "sbml_reader: no model with rules in '" << arguments[1] << "'\n";
    std::_Exit(EXIT_FAILURE);
  }
  std::_Exit(EXIT_SUCCESS);
}
