#pragma once

#include <memory>
#include <string_view>

#include "platform/xml/DocumentStorage.h"
#include "platform/xml/QEXVBTXMLNode.h"

// Reads XML documents into element trees.
//
// The reader is our own because the interface documents carry attribute names
// that begin with "@" ("@ZOR2Level", "@ZOR2Usage", "@nodoc"), which are not
// XML names, so that standard XML parsers reject the documents. It reads
// XML names in which "@" may also stand, first character included, and checks
// the rest of the structure as XML does. It is built for large documents: the
// text is read in one piece and parsed in place (the tree points into the
// buffer, which the root owns), with memchr-style scans; it never recurses over
// the input; attribute values are handed over raw; DOCTYPE declarations,
// comments, processing instructions, CDATA sections and text are skipped, and
// entities are never expanded.
class XMLReader {
 public:
  // Reads the document at `path`. Returns its root, or null with `error`
  // filled: the system's reason with line and column 0 when the file cannot be
  // read, else the first fault with its line and column.
  static std::unique_ptr<QEXVBTXMLNode> ReadFile(const char* path, XMLReadError& error);
  // Reads a document held in memory (copied first); same contract.
  static std::unique_ptr<QEXVBTXMLNode> ReadText(std::string_view text, XMLReadError& error);

 private:
  class Parser;
  static std::unique_ptr<QEXVBTXMLNode> Read(TextBuffer text, XMLReadError& error);
};
