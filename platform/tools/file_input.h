#pragma once

#include <cstddef>
#include <functional>
#include <string>

namespace zor2 {

// Why a whole input file could not be read.
struct FileReadError {
  std::string reason;  // the system's reason, or "Not a regular file"
  // The file is larger than the memory the process could ever hold: refused
  // before any of it was read.
  bool too_large = false;
};

// Where the bytes go: asked for `size` bytes of room, returns a buffer of at
// least that size that holds the first `kept` bytes of the last one it gave.
// It may throw std::bad_alloc.
using ReadRoom = std::function<char*(size_t size, size_t kept)>;

// The one reader of the files a run reads whole: documents, the baseline and
// argument files. Reads the file at `path` into the room `room` gives and sets
// `*length`. The file is opened without blocking, since a named pipe or a
// device may stand where a regular file was seen a moment before (or be named
// on purpose), and only a regular file is read: anything else is refused
// ("Is a directory", "Not a regular file"), as is a file larger than the
// memory the process could ever hold (`too_large`). The room first asked for
// is one byte more than the file's size, so that its end is seen without
// asking again; it grows should the file grow meanwhile. False with `err`
// filled when the file cannot be read.
bool ReadRegularFile(const std::string& path, const ReadRoom& room, size_t* length,
                     FileReadError* err);

}  // namespace zor2
