// How the guide looks. The help window reads the first sheet; the second is for browsers: the at-rule around
// it is one that the window does not know, so that it keeps to the colours of the desktop.
#pragma once

#include <string_view>

namespace tessal::guide {

inline constexpr std::string_view kGuideStyle =
    R"css(<style>
body { font-family: sans-serif; margin: 1.5em; }
h2 { margin-top: 1.5em; }
table { margin-top: 8px; margin-bottom: 8px; }
</style>
<style>
@supports (display: block) {
  html { color-scheme: light dark; }
  body { line-height: 1.45; max-width: 48em; margin: 1.5em auto; padding: 0 1em; }
  pre { padding: 0.6em 0.8em; overflow-x: auto; background: #f3f4f6; line-height: 1.3; }
  code { font-size: 0.95em; }
  img { max-width: 100%; height: auto; border: 1px solid #c0c4ca; }
  table { border-collapse: collapse; }
  td, th { border: 1px solid #c0c4ca; padding: 0.25em 0.6em; text-align: left; vertical-align: top; }
  hr { border: none; border-top: 1px solid #c0c4ca; }
  :target { background: #ffe066; outline: 0.2em solid #ffe066; }
}
@media screen and (prefers-color-scheme: dark) {
  body { background: #16181c; color: #dddddd; }
  pre { background: #202329; }
  a { color: #8ab4f8; }
  a:visited { color: #c58af9; }
}
@media print {
  .way { display: none; }
  h2, h3 { break-after: avoid; }
  pre, img, tr { break-inside: avoid; }
}
</style>)css";

}  // namespace tessal::guide
