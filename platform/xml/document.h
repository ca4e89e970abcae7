#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <deque>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/xml/document_storage.h"

namespace zor2::xml {

class Document;
class Parser;
class Element;

// An element of a parsed document: a tag, attributes and child elements, all
// read-only. Elements live in their document's memory and point into its text
// (see document_storage.h); they are valid as long as their document. They
// stand in document order in one array, so that an element's first child is
// the element after it, and its next sibling is found by a distance: twelve
// bytes an element.
class Element {
 public:
  Element(const Element&) = delete;
  Element& operator=(const Element&) = delete;

  const char* tag() const { return block(); }
  const Element* first_child() const { return (links_ & 1) != 0 ? this + 1 : nullptr; }
  const Element* next_sibling() const { return links_ > 1 ? this + (links_ >> 1) : nullptr; }

  // The value of attribute `name`, or null when the element has none.
  const char* FindAttribute(const char* name) const { return FindBlockValue(block(), name); }
  // Looks up several attributes in one walk over this element's attributes:
  // values[i] is set to what FindAttribute(names[i]) answers. Quickest when
  // `names` follow the order in which the element holds its attributes.
  // REQUIRES: `names` are distinct; `values` has at least as many entries.
  void FindAttributes(std::span<const std::string_view> names, std::span<const char*> values) const;

 private:
  friend class Document;
  friend class Parser;
  friend class ElementStore;
  explicit Element(const char* block) { set_block(block); }

  // The tag, followed by the attributes (document_storage.h), kept in two
  // halves so that an element needs no more than four-byte alignment.
  const char* block() const {
    const char* block;
    std::memcpy(&block, block_, sizeof block);
    return block;
  }
  void set_block(const char* block) { std::memcpy(block_, &block, sizeof block); }

  uint32_t block_[sizeof(const char*) / sizeof(uint32_t)];
  // Bit 0: the element has children; the others: the distance to the next
  // sibling in the array, 0 when there is none.
  uint32_t links_ = 0;
};

// The elements of a document, in document order, in one block of memory that
// grows without copying (its pages are remapped), so that links between
// elements can be distances. An element's address changes as the store grows:
// a reader holds indexes until it is done.
class ElementStore {
 public:
  ElementStore() = default;
  ElementStore(const ElementStore&) = delete;
  ElementStore& operator=(const ElementStore&) = delete;
  ~ElementStore();

  // Adds an element whose block is `block` and returns its index. Throws
  // std::bad_alloc when there is no memory for it.
  size_t Add(const char* block);
  size_t size() const { return size_; }
  Element& operator[](size_t index) { return elements_[index]; }
  const Element& operator[](size_t index) const { return elements_[index]; }

 private:
  Element* elements_ = nullptr;
  size_t size_ = 0;
  size_t capacity_ = 0;
};

// A rewrite of one attribute value: when `value` changes, fills `rewritten`
// and returns true; otherwise returns false and leaves `rewritten` alone.
// Values are zero-terminated: a rewritten text ends at its first zero byte.
using ValueRewrite = bool (*)(std::string_view value, std::string* rewritten);

// The text that values had before a rewrite changed them, found by where each
// rewritten value now stands; values that the rewrite left alone are not in it.
// Built by one pass, then only read: it is searched in sorted order, which
// costs one allocation for all values rather than one per value.
class OriginalValues {
 public:
  using Test = bool (*)(std::string_view text);

  // Keeps the original of a changed value only when `worth_keeping` holds for
  // it (of every changed value without it); `may_be_kept`, when given, tells
  // from a rewritten value whether its original may have been kept, so that
  // most lookups need no search.
  explicit OriginalValues(Test worth_keeping = nullptr, Test may_be_kept = nullptr)
      : worth_keeping_(worth_keeping), may_be_kept_(may_be_kept) {}

  // The text `value` had before the rewrite, if the rewrite changed it and it
  // was worth keeping.
  // REQUIRES: the pass that filled it has ended.
  std::optional<std::string_view> Find(const char* value) const;

 private:
  friend class Document;
  friend class Parser;
  struct Entry {
    const char* value;     // where the rewritten value stands
    const char* original;  // zero-terminated, in chunks_
  };
  // Whether the original of a changed value is kept.
  bool WorthKeeping(std::string_view original) const {
    return worth_keeping_ == nullptr || worth_keeping_(original);
  }
  // Values come in document order, so each run comes in increasing order of
  // place but for blocks placed out of line, which Seal sorts: values in the
  // document's text, and values in blocks of their own.
  void Add(const char* value, std::string_view original, bool in_text);
  void Seal();
  void Clear();

  Test worth_keeping_;
  Test may_be_kept_;
  std::deque<Entry> in_text_;
  std::deque<Entry> out_of_line_;
  // The original texts, in chunks that never move: no copying as they grow.
  std::vector<std::unique_ptr<char[]>> chunks_;
  char* next_ = nullptr;
  size_t left_ = 0;
};

// A parsed XML document (read with ReadDocumentFile or ReadDocumentText): its
// text in one buffer, parsed in place, and its elements.
class Document {
 public:
  // Only the reader makes documents.
  class ReaderKey {
    friend class Parser;
    ReaderKey() = default;
  };
  Document(ReaderKey, TextBuffer text) : text_(std::move(text)) {}
  Document(const Document&) = delete;
  Document& operator=(const Document&) = delete;

  const Element& root() const { return elements_[0]; }

  // Applies `rewrite` to every attribute value of every element; a rewritten
  // value replaces the old one. Values read before may be changed in place.
  // With `originals`, the old text of every value that changed is kept there.
  // (The reader can apply a rewrite as it reads, at no extra pass: see
  // ReadDocumentFile.)
  void RewriteValues(ValueRewrite rewrite, OriginalValues* originals = nullptr);

 private:
  friend class Parser;

  // Places a finished block of `size` bytes at `*out` in the text when it
  // ends by `limit`, else in the block arena; returns where it now stands.
  char* PlaceBlock(std::string_view block, char*& out, const char* limit);

  TextBuffer text_;  // the document as UTF-8, then its blocks
  ElementStore elements_;
  Arena blocks_;  // blocks that did not fit in the text
};

}  // namespace zor2::xml
