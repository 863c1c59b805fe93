// The links of area searches: to the value that they look at, which is kept by name through a renumbering; to
// their class and to the one that they look for; and the choices that the template around them offers.
#pragma once

#include <cstdint>

namespace tessal {

struct Collections;

bool HasSearchFunction(const Collections& collections);

/// Notes the name of each search's variable, before a renumbering.
void ResolveReferencesToNames(const Collections& collections);
/// Finds the number of each search's variable by its name again.
void ResolveNamesToReferences(const Collections& collections);

/// Numbers the particle classes by their places, and takes the searches for a class along to its number.
void NumberSpecies(const Collections& collections);
/// Searches for the class of that number look for none from now on: the number goes to another class.
void ForgetSpecie(const Collections& collections, std::int32_t number);

/// Fills the choice lists of all searches from the present classes and their values, and gives each search to
/// the class that holds it.
void OfferSearchChoices(const Collections& collections);
/// The same without a change of any value.
void FillSearchChoices(const Collections& collections);
/// Whether a search looks at particles, and so needs the spatial tree.
bool NeedSpatialTree(const Collections& collections);

}  // namespace tessal
