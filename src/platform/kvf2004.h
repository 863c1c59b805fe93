// The key-file library: reads a key file into targets, sections, keywords and parameters, and writes such
// files. Elements are filled from it and written through it; it drops comments.
// Handles and nodes are opaque, zero and null are "none", numbers count from 1, and names are compared
// without regard to case. A node lives as long as its handle is open.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>

#include "platform/text_source.h"

namespace tessal {

using KvfHandle = std::uint32_t;
class KvfImage;

/// A target, section, keyword or parameter of an open file, or none.
class KvfNode final {
 public:
  KvfNode() = default;
  KvfNode(std::nullptr_t /*none*/) {}  // NOLINT(google-explicit-constructor)
  /// For the library alone: the item at a place of a file's row.
  KvfNode(KvfImage& file, std::uint32_t itsPlace) : image(&file), place(itsPlace) {}

  explicit operator bool() const { return image != nullptr; }
  KvfImage* Image() const { return image; }
  std::uint32_t Place() const { return place; }
  friend bool operator==(const KvfNode& one, const KvfNode& other) = default;
  friend bool operator==(const KvfNode& node, std::nullptr_t /*none*/) { return node.image == nullptr; }

 private:
  KvfImage* image = nullptr;
  std::uint32_t place = 0;
};

/// What went wrong, as `kvfGetErrorGlb` and the calls that return an int report it.
enum KvfError : int {
  kKvfOk = 0,
  kKvfCannotOpen = 1001,
  kKvfCannotInitialiseStream = 1002,
  kKvfSyntaxError = 1003,
  kKvfCannotInitialiseParser = 1004,
  kKvfBadHandle = 1005,
  kKvfBadNode = 1006,
  kKvfWrongType = 1007,    ///< a parameter of another type than asked for
  kKvfNotWritable = 1008,  ///< a text or name that the format cannot hold
  kKvfWriteFailed = 1009,  ///< the file system refused a byte
  kKvfTooLarge = 1010,     ///< a file above `kLargestFile`
};

/// Reads and parses a file. Gives 0 on failure; `kvfGetErrorGlb` then says why. The mode is always 1.
KvfHandle kvfLoadFile(const std::string& path, int mode);

/// The same from bytes in memory.
KvfHandle kvfLoadText(std::string bytes);

/// The last error of the library, 0 for none.
int kvfGetErrorGlb();

/// Where the syntax error of the last load lies (line and position from 1) and at most 40 bytes of the text
/// near it, on one line. The handle may be the 0 of the failed load. Returns 0, or an error number.
int kvfGetSyntaxErr(KvfHandle handle, int& line, int& position, std::string& text);

/// A handle on a new, empty file image.
KvfHandle kvfCreate();

/// The same for a file whose text goes to a sink in parts, so that it is never there as a whole. Its head
/// ends with one comment more.
KvfHandle kvfCreateInto(const TextSink& sink, std::string_view lastComment);

/// Ends the sections that are still open; all of the text is then with the sink.
int kvfFinish(KvfHandle handle);

/// Releases a file and sets the handle to 0; a 0 handle is ignored.
void kvfClose(KvfHandle* handle);

KvfNode kvfTargetByNameNum(KvfHandle handle, std::string_view name, int number);
KvfNode kvfSectionByNameNum(KvfNode node, std::string_view name, int number);
int kvfGetNoSections(KvfNode node);
/// Counts from the first; who wants them all asks for the first and then for each next one.
KvfNode kvfSectionByNum(KvfNode node, int number);
KvfNode kvfFirstSection(KvfNode node);
KvfNode kvfNextSection(KvfNode section, KvfNode parent);
bool kvfIsSection(KvfNode node);
/// Whether there is a sub-section of that name. Asking is no reading.
bool kvfHasSection(KvfNode node, std::string_view name);
std::string kvfGetNameGlb(KvfNode node);
/// The line of the file, from 1, on which a target, section or keyword begins; 0 for none.
int kvfGetLine(KvfNode node);
KvfNode kvfKeywordByNameNum(KvfNode section, std::string_view name, int number);
int kvfGetNoParams(KvfNode keyword);
KvfNode kvfParamByNum(KvfNode keyword, int number);

/// Readers of one parameter: 0 when read, else an error number with the output untouched.
/// An integer outside 32 bits and a real outside 64 bits read as the nearest limit.
int kvfGetInt(KvfNode parameter, std::int32_t& value);
/// Takes integers too.
int kvfGetDouble(KvfNode parameter, double& value);
/// Quoted and path strings, and numbers and booleans as the text that is in the file.
int kvfGetString(KvfNode parameter, std::string& value);

/// A text, and whether it lies in the file's own (`kvfShareText`) and is good for as long as that is held.
/// Otherwise it lies in the buffer that the reader was given.
struct KvfText {
  std::string_view text{};
  bool isLasting = false;
};
/// The same as `kvfGetString`, without a copy but for a text that goes over a line's end.
int kvfGetText(KvfNode parameter, std::string& buffer, KvfText& value);

// What the readers above have not asked for. Asking whether something is there counts for nothing.

/// A part of a file that nobody has read.
struct KvfUnread {
  enum class What { Section, Keyword, FurtherValues };

  What what;
  KvfNode node;    ///< the section or keyword
  KvfNode parent;  ///< the section that it lies in
};

/// A comment of a file: its line, from 1, and its text.
struct KvfRemark {
  int line;
  std::string_view text;
};

/// Visits the unread parts of a section, in the order of the file; of a section that is unread as a whole no
/// parts.
void kvfForEachUnread(KvfNode section, const std::function<void(const KvfUnread&)>& visit);
/// Counts a keyword as read, with all its values.
void kvfMarkRead(KvfNode keyword);
/// A keyword with its values as the file has them, on one line but for line feeds in its texts; what is
/// longer ends in three points.
std::string kvfGetSource(KvfNode keyword, std::size_t longest);
/// Whether a number fits the type that it is read as; otherwise its nearest limit is read.
bool kvfFitsInt(KvfNode parameter);
bool kvfFitsDouble(KvfNode parameter);

/// The text of a new file, as `kvfWrite` writes it; the file is closed. Empty for any other handle.
std::string kvfTakeText(KvfHandle* handle);
/// The text of a file that was loaded, up to a zero byte, without a mark of the byte order. It outlives the
/// file. Null for any other handle.
std::shared_ptr<const std::string> kvfShareText(KvfHandle handle);
/// Whether that text keeps to the grammar of the item tree too. False where it may not.
bool kvfIsStrict(KvfHandle handle);
/// The text beside a target, from the first top-level section on, with CRLF line ends and no blank lines at
/// its ends. With none for the target, all of it.
std::string kvfTextBeside(KvfHandle handle, KvfNode target);
/// Visits the comments in the head of the file and inside the target, without those that the library itself
/// writes.
void kvfForEachRemark(KvfHandle handle, KvfNode target, const std::function<void(const KvfRemark&)>& visit);
/// How many bytes of the file lie after a zero byte, and so were not read.
std::size_t kvfGetBytesCut(KvfHandle handle);

/// Writing: the image holds a stack of open sections; a keyword takes the parameters added after it.
/// Each returns 0 when done, else an error number, and adds nothing then.
int kvfAddTarget(KvfHandle handle, std::string_view name);
int kvfAddSection(KvfHandle handle, std::string_view name);
int kvfEndSection(KvfHandle handle);
int kvfAddKeyword(KvfHandle handle, std::string_view name);
int kvfAddInt(KvfHandle handle, std::int32_t value);
/// Refuses a value that is not finite.
int kvfAddDouble(KvfHandle handle, double value);
/// Refuses a text that holds both ' and |, or a zero byte.
int kvfAddString(KvfHandle handle, std::string_view value);

/// Writes the image as text with CRLF line ends into a new file, in the place of what was there; 0 when
/// every byte reached the file and was flushed to it, else an error number; `kvfGetWriteFailure` then says
/// why in words.
int kvfWrite(KvfHandle handle, const std::string& path);
std::string kvfGetWriteFailure();

}  // namespace tessal
