// How the page looks where no MathJax renders it. Browsers know MathML Core, which lays an `mfenced` out as a
// plain row: without brackets, without the commas between arguments and without the brace of a conditional.
// The rules draw them. Everything stays in mathematical layout, where generated text is not shown and
// flexible boxes lose the spaces around operators; so brackets are borders, which also grow with what they
// hold, and the brace and the comma are small pictures in the rules themselves.
// The page itself: an index that stays in sight, equations that scroll by themselves where they are too wide,
// a mark on the target of a link, dark colours for readers who want them, and paper, which needs no index.
// The columns have colours and widths of their own, which only an important rule outdoes.
#pragma once

#include <string_view>

namespace tessal {

inline constexpr std::string_view kPageStyle =
    R"css(<style>
html { color-scheme: light dark; scroll-padding-top: 0.5em; }
body { font-family: sans-serif; line-height: 1.35; }
#container { display: flow-root; }
#left, #right { box-sizing: border-box; padding: 0 0.8em; }
#left { position: sticky; top: 0; height: 100vh; overflow: auto; overscroll-behavior: contain; }
#left ul ul { margin: 0; padding-left: 1em; list-style: none; }
#left h4 { margin: 0; font-weight: normal; overflow-wrap: anywhere; }
#right ul { padding-left: 1em; list-style: none; }
#footer { clear: both; }
table { width: 100%; table-layout: fixed; }
td { vertical-align: top; overflow-wrap: anywhere; }
td + td { display: block; overflow-x: auto; }
:target { background: #ffe066; outline: 0.2em solid #ffe066; }
math { font-size: 1.1em; width: max-content; }
math mfenced { margin: 0 0.1em; padding: 0.12em 0.25em; border: solid; border-width: 0 0.07em;
  border-radius: 0.5em / 50%; }
math mfenced:not([separators]) { padding: 0 0.25em; }
math mfenced:not([separators]) > mrow { padding: 0.25em 0; }
math mfenced:not([separators]) > mrow:not(:last-child) { padding-right: 0.6em;
  background: no-repeat right 0.25em top calc(50% + 0.4em) / 0.2em 0.4em url("data:image/svg+xml,%3Csvg xmlns='http://www.w3.org/2000/svg' viewBox='0 0 10 20'%3E%3Cpath d='M3 5a3 3 0 1 1 4 4Q7 15 1 19Q4 14 4 10Z'/%3E%3C/svg%3E");
  -webkit-print-color-adjust: exact; print-color-adjust: exact; }
math mfenced:empty { padding: 0.75em 0.25em 0.2em; }
math mfenced[open] { margin: 0 0 0 0.2em; padding: 0; border-width: 0 0 0 0.6em; border-radius: 0;
  border-image: url("data:image/svg+xml,%3Csvg xmlns='http://www.w3.org/2000/svg' width='12' height='100' viewBox='0 0 12 100' preserveAspectRatio='none'%3E%3Cpath d='M11 1Q6 1 6 12V38Q6 50 1 50Q6 50 6 62V88Q6 99 11 99' fill='none' stroke='black' stroke-width='1.3' vector-effect='non-scaling-stroke'/%3E%3C/svg%3E") 0 0 0 12 stretch; }
math mtd { padding: 0.2em 0.4em; text-align: left; math-style: normal; }
math mfrac > mrow { padding: 0.1em 0; }
math mfrac mfrac > *, math msup > :last-child mfrac > * { math-depth: 1; }
math msup > :last-child msup > :last-child { math-depth: 2; }
math mtext[mathcolor='blue'] { color: blue; }
math mtext[mathcolor='green'] { color: green; font-weight: bold; font-style: italic; }
math mi + mtext[mathcolor='green'] { margin: 0 0.3em; }
math :not(mfrac, msup, mfenced:not([separators])) > :is(mi, mn, mrow, mfrac, mfenced, mtext:not([mathcolor]))
  + :is(mi, mn, mrow, mfrac, mfenced:not([open]), mtext:not([mathcolor='green'])) { margin-left: 0.6em; }
math > mrow > mfrac:first-child > mrow:first-child > mi:last-child { margin-left: 0; }
@media screen and (max-width: 45em) {
  #left, #right { float: none !important; width: auto !important; }
  #left { position: static; height: auto; max-height: 50vh; }
}
@media screen and (prefers-color-scheme: dark) {
  body { background: #16181c; color: #dddddd; }
  #left { background: #2d2a16 !important; }
  #right { background: #202329 !important; }
  a { color: #8ab4f8; }
  a:visited { color: #c58af9; }
  a[id] { color: inherit; }
  :target { background: #7a5c00; outline-color: #7a5c00; }
  math mtext[mathcolor='blue'] { color: #8ab4f8; }
  math mtext[mathcolor='green'] { color: #81c995; }
  math mfenced:not([separators]) > mrow:not(:last-child) { background-image: url("data:image/svg+xml,%3Csvg xmlns='http://www.w3.org/2000/svg' viewBox='0 0 10 20'%3E%3Cpath fill='%23ddd' d='M3 5a3 3 0 1 1 4 4Q7 15 1 19Q4 14 4 10Z'/%3E%3C/svg%3E"); }
  math mfenced[open] { border-image-source: url("data:image/svg+xml,%3Csvg xmlns='http://www.w3.org/2000/svg' width='12' height='100' viewBox='0 0 12 100' preserveAspectRatio='none'%3E%3Cpath d='M11 1Q6 1 6 12V38Q6 50 1 50Q6 50 6 62V88Q6 99 11 99' fill='none' stroke='%23ddd' stroke-width='1.3' vector-effect='non-scaling-stroke'/%3E%3C/svg%3E"); }
}
@media print {
  html { color-scheme: light; }
  #left { display: none; }
  #right { float: none !important; width: auto !important; background: none !important; padding: 0; }
  a { color: inherit; text-decoration: none; }
  h2, h3, h4 { break-after: avoid; }
  tr { break-inside: avoid; }
  td + td { overflow: visible; }
  :target { background: none; outline: none; }
}
</style>)css";

}  // namespace tessal
