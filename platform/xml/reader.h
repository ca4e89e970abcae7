#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "platform/tools/file_input.h"
#include "platform/xml/document.h"
#include "platform/xml/read_error.h"

namespace zor2::xml {

// Reading XML documents.
//
// The reader is our own because interface documents carry attribute names
// that begin with "@" ("@ZOR2Level", "@ZOR2Usage", "@nodoc"), which are not
// XML names, so that standard XML parsers reject the documents. It reads XML
// names in which "@" may also stand, first character included, and checks the
// rest of the structure as XML does. It is built for large documents: the text
// is read in one piece and parsed in place, with memchr-style scans, and it
// never recurses over the input. Attribute values are handed over raw, entity
// references not decoded; DOCTYPE declarations, comments, processing
// instructions, CDATA sections and text are skipped, and entities are never
// expanded. Documents in UTF-16 or UTF-32 with a byte-order mark, or in an
// encoding their XML declaration names, are converted to UTF-8 first.

// How attribute values are prepared as a document is read: `rewrite`
// applied to every value as Document::RewriteValues(rewrite, originals) would,
// without a pass of its own. No rewrite: values as written.
struct ReadPreparation {
  ValueRewrite rewrite = nullptr;
  OriginalValues* originals = nullptr;
};

// Reads the document at `path` into `document`. False with `err` filled when
// the file cannot be read (the system's reason, line and column 0; "Not a
// regular file" for anything else found there when it is opened, which never
// blocks; kNotEnoughMemory for a file larger than `memory_limit`, the memory
// the process could ever hold) or is not well-formed (the first fault, with
// its line and column). Other allocation failures throw std::bad_alloc. A
// large document is read in windows, and keeps little more than its start
// tags.
bool ReadDocumentFile(const std::string& path, uintmax_t memory_limit,
                      const ReadPreparation& preparation, std::unique_ptr<Document>* document,
                      ReadError* err);

// The same, with values as written and MemoryLimit() measured for it.
bool ReadDocumentFile(const std::string& path, std::unique_ptr<Document>* document, ReadError* err);

// Reads a document held in memory (copied first), values as written; same
// contract.
bool ReadDocumentText(std::string_view text, std::unique_ptr<Document>* document, ReadError* err);

// The most memory the process could ever hold (one rule for every input file).
using ::zor2::MemoryLimit;

// Reads a document held in memory (copied first); same contract.
bool ReadDocumentText(std::string_view text, std::unique_ptr<Document>* document, ReadError* err);

}  // namespace zor2::xml
