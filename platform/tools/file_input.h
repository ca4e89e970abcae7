#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>

#include "platform/tools/file_descriptor.h"

namespace zor2 {

// Reading the files a run reads whole: documents, the baseline and argument
// files, all by the same rules.

// Why an input file could not be read.
struct FileReadError {
  std::string reason;  // the system's reason, or "Not a regular file"
  // The file is larger than the memory the process could ever hold: refused
  // before any of it was read.
  bool too_large = false;
};

// The most memory the process could ever hold: the machine's memory and swap,
// or less when the process is limited.
uintmax_t MemoryLimit();

// Opens the file at `path` for reading and sets `*size`. It is opened without
// blocking, since a named pipe or a device may stand where a regular file was
// seen a moment before (or be named on purpose), and only a regular file is
// accepted: anything else is refused ("Is a directory", "Not a regular
// file"), as is a file of `memory_limit` bytes or more (`too_large`). False
// with `err` filled when the file cannot be opened or is refused.
bool OpenRegularFile(const std::string& path, uintmax_t memory_limit, FileDescriptor* file,
                     size_t* size, FileReadError* err);

// Where the bytes go: asked for `size` bytes of room, returns a buffer of at
// least that size that holds the first `kept` bytes of the last one it gave.
// It may throw std::bad_alloc.
using ReadRoom = std::function<char*(size_t size, size_t kept)>;

// Reads the open `file`, `size` bytes long when it was opened, to its end into
// the room `room` gives, and sets `*length`. The room first asked for is one
// byte more than `size`, so that the end is seen without asking again; it
// grows should the file grow meanwhile. False with `err` filled when the file
// cannot be read.
bool ReadOpenFile(int file, size_t size, const ReadRoom& room, size_t* length, FileReadError* err);

// Both, with MemoryLimit(): the whole regular file at `path`.
bool ReadRegularFile(const std::string& path, const ReadRoom& room, size_t* length,
                     FileReadError* err);

}  // namespace zor2
