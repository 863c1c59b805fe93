// The content of a key file in the formats of other libraries: a section is an object or an element, a
// keyword is a member or an element in it. Comments are left out.
#pragma once

#include <cstddef>
#include <string>

namespace tessal {

class CKvfSectionItem;

namespace bench {

/// The tree of a text. Throws `std::runtime_error` when it can not be read.
void ReadTree(const std::string& text, CKvfSectionItem& tree);

std::string ContentAsJson(const CKvfSectionItem& tree);
/// Without blanks and line ends between the elements.
std::string ContentAsXml(const CKvfSectionItem& tree);

/// How many sections, keywords and values there are.
std::size_t CountNodes(const CKvfSectionItem& tree);

}  // namespace bench

}  // namespace tessal
