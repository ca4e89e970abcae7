#pragma once

#include <string>
#include <string_view>

#include "platform/xml/DocumentStorage.h"

// Reading and writing whole document files.

// Reads the file at `path` in one piece into `text`. Returns false with the
// system's reason (for a directory, that of EISDIR) when it cannot be read.
bool ReadDocumentFile(const char* path, TextBuffer& text, std::string& reason);

// Writes `bytes` to `path`. A regular file, or a path that does not exist, is
// written to a new temporary file in the same directory that is then renamed
// over it, keeping the permission bits of a replaced file; a path that exists
// and is not a regular file by lstat (a symbolic link, a device, a pipe) is
// opened and written directly. Returns 0, or non-zero with the system's reason
// when any step fails (the temporary file is then removed).
int WriteDocumentFile(const char* path, std::string_view bytes, std::string& reason);
