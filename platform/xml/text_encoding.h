#pragma once

#include <cstddef>
#include <string_view>

#include "platform/xml/document_storage.h"
#include "platform/xml/read_error.h"

namespace zor2::xml {

// Character encodings of documents: the reader parses UTF-8 only, so other
// encodings are converted first, with iconv.

// Brings the bytes of a document to UTF-8. A UTF-8 byte-order mark is only
// skipped: `*start` is set past it (0 otherwise). UTF-16 and UTF-32 with a
// byte-order mark, and documents whose XML declaration names an encoding other
// than UTF-8 (or ASCII), are converted into a new buffer that replaces `*text`.
// Returns false with `err` filled when iconv does not know the declared
// encoding, the system cannot set up the conversion (no position then), or the
// bytes are not valid in it.
bool ConvertToUtf8(TextBuffer* text, size_t* start, ReadError* err);

// Whether ConvertToUtf8 would leave the document that begins with `head` as
// it is, but for skipping a UTF-8 byte-order mark: false when it would
// convert or refuse it, or when `head` (the whole document when `whole`) does
// not tell.
bool IsPlainUtf8(std::string_view head, bool whole);

// Sets the 1-based line and column, counted in characters, of `position` in
// the UTF-8 text that starts at `begin`. A lone carriage return, a carriage
// return and line feed, and a lone line feed each end one line.
void LocateInText(const char* begin, const char* position, int* line, int* column);

}  // namespace zor2::xml
