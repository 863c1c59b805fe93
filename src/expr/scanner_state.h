// What the generated scanner and its owner share. Nobody else includes this.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "expr/scanner.h"

namespace tessal {

/// Counted since the beginning of the scan.
struct ScanPosition {
  std::uint32_t consumed = 0;   ///< characters taken, the present token's included
  std::uint32_t lines = 0;      ///< line feeds outside comments
  std::uint32_t lineStart = 0;  ///< characters taken when the present line began
};

ScanPosition& ScannerCounters();

/// Begins a scan of the text in its place; it gets the two zero bytes that end it for the scanner.
void BeginFlexScan(std::string& text);
void EndFlexScan();
TokenCode NextFlexToken();
std::string_view FlexLexeme();
ScannerStart FlexStart();
void SetFlexStart(ScannerStart start);

}  // namespace tessal
