// How the page looks where no MathJax renders it. Browsers know MathML Core, which has no fences of its own
// and ignores unknown elements' brackets; the rules give them back: round brackets around a fence, commas
// between the arguments of a function, and a brace ahead of the two rows of a conditional.
#pragma once

#include <string_view>

namespace tessal {

inline constexpr std::string_view kPageStyle =
    "<style>\n"
    "math { font-size: 1.1em; }\n"
    "math mfenced { display: inline-flex; align-items: center; }\n"
    "math mfenced::before { content: '('; padding-right: 0.1em; }\n"
    "math mfenced::after { content: ')'; padding-left: 0.1em; }\n"
    "math mfenced:not([separators]) > mrow:not(:last-child)::after { content: ','; padding-right: 0.3em; }\n"
    "math mfenced[open='{'] { border-left: 2px solid; border-top-left-radius: 0.6em;\n"
    "  border-bottom-left-radius: 0.6em; padding-left: 0.4em; margin-left: 0.3em; vertical-align: middle; }\n"
    "math mfenced[open='{']::before, math mfenced[open='{']::after { content: none; }\n"
    "math mtd { text-align: left; padding: 0.2em 0.4em; }\n"
    "math mtext[mathcolor='blue'] { color: blue; }\n"
    "math mtext[mathcolor='green'] { color: green; font-weight: bold; font-style: italic; }\n"
    "</style>";

}  // namespace tessal
