#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string_view>
#include <vector>

namespace zor2::xml {

// How a parsed document is kept in memory: its text in one buffer, parsed in
// place, plus two arenas owned by the document.

// A document's bytes, followed by one zero byte that every scan of the reader
// uses as end sentinel, and by spare capacity.
struct TextBuffer {
  std::unique_ptr<char[]> bytes;  // capacity bytes, bytes[size] == 0
  size_t size = 0;
  size_t capacity = 0;

  // A buffer for `size` bytes (contents undefined) with the sentinel in place
  // and `spare` more bytes of capacity.
  static TextBuffer Allocate(size_t size, size_t spare = 0);
  char* data() const { return bytes.get(); }
};

// A bump allocator in chunks: cheap allocations that are all released at once
// when the arena goes. Nothing is constructed or destroyed by the arena.
class Arena {
 public:
  Arena() = default;
  Arena(const Arena&) = delete;
  Arena& operator=(const Arena&) = delete;

  // `size` bytes aligned to `align` (a power of two, at most 16), valid until
  // the arena is destroyed.
  void* Allocate(size_t size, size_t align) {
    size_t pad = (0 - reinterpret_cast<uintptr_t>(next_)) & (align - 1);
    if (pad + size > left_) return AllocateInNewChunk(size, align);
    std::byte* block = next_ + pad;
    next_ = block + size;
    left_ -= pad + size;
    return block;
  }

 private:
  void* AllocateInNewChunk(size_t size, size_t align);

  std::vector<std::unique_ptr<std::byte[]>> chunks_;
  std::byte* next_ = nullptr;
  size_t left_ = 0;
  size_t chunk_size_ = 4096;
};

// The attribute block of a parsed element. The reader leaves each start tag in
// the buffer as
//   tag \0 { separators name \0 [white space] [=] [white space] quote value \0 } ( ">" | "/" )
// where separators are white space and zero bytes: the tag moved one byte left
// over the "<", and a zero byte written over the character after each
// attribute name and over each closing quote. No byte moves but the tag, so a
// reading position keeps its line and column. A value shortened in place is
// padded with zero bytes. A value that grew beyond its slot is moved to the
// spare capacity after the text: its quote is replaced by kMovedValue and the
// next four bytes hold the offset from that marker to the moved value (the
// rest of the slot is zeroed). A block rebuilt elsewhere has the first form,
// without white space.
constexpr char kMovedValue = '\x01';
constexpr size_t kMovedValueSlot = 5;  // the marker and the offset

inline bool IsBlockSeparator(char c) {
  return c == '\0' || c == ' ' || c == '\n' || c == '\t' || c == '\r';
}

// From just after an attribute name: finds the value's slot, sets `value`,
// and returns the position after the value.
inline const char* ReadBlockValue(const char* p, const char*& slot, const char*& value) {
  while (*p != '"' && *p != '\'' && *p != kMovedValue) ++p;
  slot = p;
  if (*p == kMovedValue) {
    int32_t offset;
    std::memcpy(&offset, p + 1, sizeof offset);
    value = p + offset;
    return p + kMovedValueSlot;
  }
  value = p + 1;
  return value + std::strlen(value);
}

// Walks the attributes of a block in order.
class BlockAttributes {
 public:
  explicit BlockAttributes(const char* block) : p_(block + std::strlen(block) + 1) {}
  // Moves to the next attribute and sets its name, value and value slot (the
  // quote or kMovedValue); false at the end.
  bool Next(const char*& name, const char*& value, const char*& slot) {
    while (IsBlockSeparator(*p_)) ++p_;
    if (*p_ == '>' || *p_ == '/') return false;
    name = p_;
    p_ = ReadBlockValue(p_ + std::strlen(p_), slot, value);
    return true;
  }
  bool Next(const char*& name, const char*& value) {
    const char* slot;
    return Next(name, value, slot);
  }
  // The same, with the lengths of name and value, which the walk measures
  // anyway (but for a moved value).
  bool Next(std::string_view& name, std::string_view& value, const char*& slot) {
    while (IsBlockSeparator(*p_)) ++p_;
    if (*p_ == '>' || *p_ == '/') return false;
    name = std::string_view(p_);
    const char* text;
    p_ = ReadBlockValue(p_ + name.size(), slot, text);
    value = *slot == kMovedValue ? std::string_view(text) : std::string_view(text, p_ - text);
    return true;
  }

 private:
  const char* p_;
};

// The value of attribute `name` in a block, or null. Compares while it walks,
// so that a mismatch costs one character.
inline const char* FindBlockValue(const char* block, const char* name) {
  const char* p = block + std::strlen(block) + 1;
  for (;;) {
    while (IsBlockSeparator(*p)) ++p;
    if (*p == '>' || *p == '/') return nullptr;
    const char* n = name;
    while (*p == *n && *n != '\0') {
      ++p;
      ++n;
    }
    bool found = *n == '\0' && *p == '\0';
    const char* slot;
    const char* value;
    p = ReadBlockValue(p, slot, value);
    if (found) return value;
  }
}

}  // namespace zor2::xml
