#pragma once

#include <string>

namespace zor2::xml {

// Why a document could not be read: the system's reason, or a fault of the
// text with the 1-based line and column where it stands (both 0 when there is
// no position, as for a file that cannot be opened).
struct ReadError {
  std::string reason;
  int line = 0;
  int column = 0;
};

// Why a document could not be held in memory.
inline constexpr char kNotEnoughMemory[] = "not enough memory to read the document";

}  // namespace zor2::xml
