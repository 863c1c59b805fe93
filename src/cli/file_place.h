// Where something is in a file, as people and editors count.
#pragma once

namespace tessal::cli {

/// Line and columns from 1, 0 where they are not known. Columns count characters; the end column is that
/// after the last one, 0 for what goes on in another line.
struct FilePlace {
  int line = 0;
  int column = 0;
  int endColumn = 0;
};

}  // namespace tessal::cli
