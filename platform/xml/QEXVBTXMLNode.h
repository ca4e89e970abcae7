#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>

class Arena;
struct ParsedDocument;

// Why a document could not be read: the system's reason or a parse fault, with
// the 1-based line and column of the fault (both 0 when there is no position,
// as for a file that cannot be opened).
struct XMLReadError {
  std::string reason;
  int line = 0;
  int column = 0;
};

// A rewrite of one attribute value, as changeAttributeValues applies it: when
// the value changes, the function fills `rewritten` and returns non-zero;
// otherwise it returns 0 and leaves `rewritten` alone.
using QEXAttributeRewrite = int (*)(std::string_view value, std::string& rewritten);

// Opaque iteration position over the children of an element; null means "no
// more". It points at the child that getNextNode will return.
using QEXVBTXMLPosition = const void*;

// An XML element: a tag, attributes in the order they were set, and child
// elements in the order they were appended. An element owns its children and
// its attribute values; text content is not kept.
//
// A document read by CreateFromFile keeps the file's bytes in one buffer owned
// by its root: tags, names and values point into that buffer, so every element
// of a document must be discarded with (or before) its root.
class QEXVBTXMLNode {
 public:
  virtual ~QEXVBTXMLNode();
  QEXVBTXMLNode(const QEXVBTXMLNode&) = delete;
  QEXVBTXMLNode& operator=(const QEXVBTXMLNode&) = delete;

  // Reads the XML document at `path` and returns its root element, or null with
  // `error` filled when the file cannot be read or is not well-formed.
  // Attribute values are handed over exactly as they stand between the quotes:
  // entity references are not decoded and white space is not converted.
  static std::unique_ptr<QEXVBTXMLNode> CreateFromFile(const char* path, XMLReadError& error);
  // Parses a document held in memory; `text` is copied. Same contract as
  // CreateFromFile.
  static std::unique_ptr<QEXVBTXMLNode> CreateFromText(std::string_view text, XMLReadError& error);
  // A new element without attributes or children.
  static std::unique_ptr<QEXVBTXMLNode> CreateNode(const char* tag);

  const char* getTag() const;

  // The value of attribute `name`, or null when the element has none. The
  // pointer stays valid until the value is set again or the element is
  // discarded. The second parameter is unused.
  const char* getAttributeValue(const char* name, const void* unused = nullptr) const;
  // Looks up several attributes in one walk over this element's attributes:
  // values[i] is set to what getAttributeValue(names[i]) answers. Cheaper than
  // one lookup per name when an element has several attributes to skip, the
  // more so when `names` follow the order of the element's attributes.
  // `names` are distinct; `values` has at least as many entries.
  void getAttributeValues(std::span<const std::string_view> names,
                          std::span<const char*> values) const;
  // Adds attribute `name` at the end, or replaces the value of an existing one
  // in place. Both strings are copied.
  void setAttributeValue(const char* name, const char* value);

  // Appends `child` as the last child and takes ownership of it. Returns the
  // child, which stays valid as long as this element keeps it.
  QEXVBTXMLNode* insertNodeAtEnd(std::unique_ptr<QEXVBTXMLNode> child);
  // Detaches `child` (a direct child of this element) and discards it with its
  // subtree.
  void removeNode(QEXVBTXMLNode* child);

  // Iteration over the direct children: the position of the first child, or
  // null when there is none. The parameter is unused.
  QEXVBTXMLPosition getFirstNodePosition(const void* unused = nullptr) const;
  // Returns the child at `position` and moves `position` to the next child
  // (null after the last). Removing the child just returned does not disturb
  // the iteration. The second parameter is unused.
  QEXVBTXMLNode* getNextNode(QEXVBTXMLPosition& position, const void* unused = nullptr) const;

  // Writes this element and its subtree to `path` as a UTF-8 XML document with
  // an XML declaration, indented, attributes in their order and values exactly
  // as held (callers escape them first). A regular file (or a new path) is
  // written to a temporary file beside it and renamed into place, so a failed
  // write never leaves a truncated document; a path that exists and is not a
  // regular file by lstat (a symbolic link, a device, a pipe) is written
  // directly and never replaced. Returns 0, or non-zero with `error` filled
  // (the system's reason) when the document cannot be written.
  int writeInFile(const char* path, std::string& error) const;
  // The same document as writeInFile would write, appended to `out`.
  void writeTo(std::string& out) const;

 protected:
  explicit QEXVBTXMLNode(const char* tag);

 private:
  friend void changeAttributeValues(QEXVBTXMLNode* root, QEXAttributeRewrite rewrite);
  friend class XMLReader;
  // Representation: chosen for reading large documents in place (see the
  // source file).
  struct Extra;
  struct RewritePass;
  struct ParsedTag {};
  static constexpr uintptr_t kHasExtra = 1;

  // An element of a parsed document, placed in its document's node arena.
  QEXVBTXMLNode(const char* block, ParsedTag) noexcept;
  static QEXVBTXMLNode* NewParsedNode(Arena& nodes, const char* block);
  // Makes this (built) element the root of a parsed document, which it owns.
  void AdoptDocument(std::unique_ptr<ParsedDocument> document);
  void SetParsedBlock(const char* block);
  // Appends a parsed child after `last`, the parent's last child (or null).
  static void AppendParsed(QEXVBTXMLNode* parent, QEXVBTXMLNode* last, QEXVBTXMLNode* child) {
    if (last != nullptr) {
      last->SetNext(child);
    } else {
      parent->first_child_ = child;
    }
  }

  QEXVBTXMLNode* next() const { return reinterpret_cast<QEXVBTXMLNode*>(next_ & ~kHasExtra); }
  void SetNext(QEXVBTXMLNode* next) {
    next_ = reinterpret_cast<uintptr_t>(next) | (next_ & kHasExtra);
  }
  Extra* extra() const;
  Extra& EnsureExtra();
  const char* block() const;
  void SetBlock(const char* block);
  bool IsHeapNode() const;
  bool OwnsDocument() const;
  QEXVBTXMLNode* LastChild();
  QEXVBTXMLNode* PreviousSibling(QEXVBTXMLNode* child, bool& is_child) const;

  Extra& OwnedAttributes();
  void SetOwnedValue(const char* name, std::string_view value);
  void RewriteValues(RewritePass& pass);
  // Calls enter(node, depth) on `root` (depth 0) and on each of its
  // descendants in document order, and leave(node, depth) on each element
  // that has children once they have all been visited. Iterative, whatever
  // the depth; the siblings of `root` are not visited.
  template <typename Node, typename Enter, typename Leave>
  static void WalkInDocumentOrder(Node* root, Enter enter, Leave leave);
  void RewriteBlock(RewritePass& pass);
  void RebuildBlock(RewritePass& pass);
  void AppendStartTag(std::string& out) const;
  static void DiscardList(QEXVBTXMLNode* first);

  // The tag, followed by the attributes of a parsed element (see
  // DocumentStorage.h); or, when next_ carries kHasExtra, this element's
  // Extra, which it owns.
  const void* data_;
  // The next sibling, with kHasExtra in its lowest bit.
  uintptr_t next_;
  QEXVBTXMLNode* first_child_ = nullptr;
};

// Applies `rewrite` to every attribute value of `root` and of all its
// descendants, in document order; a rewritten value replaces the old one.
void changeAttributeValues(QEXVBTXMLNode* root, QEXAttributeRewrite rewrite);
