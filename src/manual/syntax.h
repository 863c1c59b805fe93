// Syntax definitions of template files for editors of text: sections, keywords, quoted texts, and the
// expressions within them.
#pragma once

#include <string>

namespace tessal::manual {

/// For Kate and all that uses its engine.
std::string KateSyntax();
/// For Vim, and how it knows a template's file.
std::string VimSyntax();
std::string VimDetection();
/// For TextMate and the editors that read its grammars.
std::string TextMateSyntax();

}  // namespace tessal::manual
