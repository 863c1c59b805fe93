// Reading and writing one property as one keyword of a key-file section.
#pragma once

#include <string>
#include <string_view>

#include "elements/read_status.h"
#include "platform/kvf2004.h"

namespace tessal {

class CEL_Element;
class CEL_Property;

/// Reads the keyword into the property. A missing key, and a parameter of the wrong type, is reported at
/// level 3 and sets the status. Numbers are read, and reported, only while it is good; a text that was
/// read makes it good again, so that of a run of missing numbers one is reported. What is not read is in the
/// account of the load in any case.
void ReadProperty(CEL_Property& property, KvfNode section, std::string_view key, ReadStatus& status);

/// Reads a keyword as text, cleaned at both ends. False, with a report, when it is missing.
bool ReadText(std::string& text, KvfNode section, std::string_view key, ReadStatus& status);

/// Reads an integer keyword; false, with a report, when it is missing or no integer.
bool ReadInteger(std::int32_t& value, KvfNode section, std::string_view key, ReadStatus& status);

bool HasKeyword(KvfNode section, std::string_view key);

/// Writes the property as a keyword into the open section. What the format cannot hold is reported at level
/// 3 under the element's symbol, and sets the status.
void WriteProperty(const CEL_Property& property, KvfHandle file, std::string_view key, CEL_Element& element,
                   int& status);
void WriteText(std::string_view text, KvfHandle file, std::string_view key, CEL_Element& element,
               int& status);
void WriteInteger(std::int32_t value, KvfHandle file, std::string_view key, CEL_Element& element,
                  int& status);

/// Notes the result of a library call that added something: reports and sets the status unless it is 0.
void NoteWriteResult(int result, std::string_view key, CEL_Element& element, int& status);

/// Cuts blanks, tabs and line ends off both ends.
std::string_view CleanText(std::string_view text);

/// The text of the last key that could not be read, process-wide.
const std::string& LastKeyError();
void NoteKeyError(std::string_view text);
void ClearLastKeyError();

}  // namespace tessal
