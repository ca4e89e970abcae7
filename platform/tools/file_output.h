#pragma once

#include <string>
#include <string_view>

namespace zor2 {

// Writes `bytes` to the file at `path` so that the file is never left
// half-written: a regular file, or a path that does not exist yet, is written
// to a new temporary file in the same directory (".zor2check." and six random
// letters, whatever the length of the file's name), which is then renamed over
// it (a replaced file keeps its permission bits; a new one gets 0644 less the
// umask). Through a symbolic link (or a chain of them, the last one possibly
// dangling) the same is done beside the file the link leads to, and the link
// stays. A path that leads to something other than a regular file (a device,
// a pipe) is written in place (WriteFileInPlace). False with the system's
// reason in `err` when any step fails; the temporary file is then removed.
// `opened`, when given, tells whether the file (or the temporary one) could be
// opened at all. Several outputs may be written at once, from several threads.
bool WriteFileAtomically(const std::string& path, std::string_view bytes, bool* opened,
                         std::string* err);

// Sets `target` to the file that `path` finally names, its symbolic links
// followed (the last one may dangle), or to `path` when it is no link: the
// file that WriteFileAtomically replaces. False with errno set when a link
// cannot be read or the links loop.
bool FinalTarget(const std::string& path, std::string* target);

// Names the temporary files of the outputs after `program` ("." + program +
// "." and six random letters); they are zor2check's otherwise. Call once,
// before any output is written.
void NameTemporaryFilesAfter(std::string_view program);

// Makes SIGINT and SIGTERM (unless ignored from the start) remove the
// temporary file being written before the process ends by the signal, and
// makes a write past the file size limit fail with EFBIG rather than end the
// process (SIGXFSZ ignored). Call once, before any output is written.
void RemoveTemporaryFilesOnInterrupt();

// Writes `bytes` to the file at `path`, created or truncated, in place. The
// file is opened without blocking: a named pipe that no process reads fails
// ("No process is reading the pipe"), one with a reader is written as usual.
// False with the system's reason in `err` when it cannot; `*opened` then tells
// whether the file could be opened at all.
bool WriteFileInPlace(const std::string& path, std::string_view bytes, bool* opened,
                      std::string* err);

}  // namespace zor2
