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
  // and `spare` more bytes of capacity. Pages of a large buffer that are never
  // written cost no memory.
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

// The attribute block of a parsed element, once its start tag has been read:
//   tag \0 { name \0 value \0 } ">"
// The reader writes each block over the text it has already parsed (or, when
// a block would overtake text still to be read, into an arena of the
// document), so that a document holds little more than its start tags.
constexpr char kBlockEnd = '>';

// Walks the attributes of a block in order.
class BlockAttributes {
 public:
  explicit BlockAttributes(const char* block) : p_(block + std::strlen(block) + 1) {}
  // Moves to the next attribute and sets its name and value; false at the end.
  bool Next(const char*& name, const char*& value) {
    if (*p_ == kBlockEnd) return false;
    name = p_;
    value = p_ + std::strlen(p_) + 1;
    p_ = value + std::strlen(value) + 1;
    return true;
  }
  // The same, with the lengths of name and value, which the walk measures
  // anyway.
  bool Next(std::string_view& name, std::string_view& value) {
    if (*p_ == kBlockEnd) return false;
    name = std::string_view(p_);
    value = std::string_view(p_ + name.size() + 1);
    p_ = value.data() + value.size() + 1;
    return true;
  }
  // Where the walk stands: after the last attribute, the block's end.
  const char* position() const { return p_; }

 private:
  const char* p_;
};

// The value of attribute `name` in a block, or null. Compares while it walks,
// so that a mismatch costs one character.
inline const char* FindBlockValue(const char* block, const char* name) {
  const char* p = block + std::strlen(block) + 1;
  while (*p != kBlockEnd) {
    const char* n = name;
    while (*p == *n && *n != '\0') {
      ++p;
      ++n;
    }
    const bool found = *n == '\0' && *p == '\0';
    p += std::strlen(p) + 1;  // past the rest of the name
    if (found) return p;
    p += std::strlen(p) + 1;  // past the value
  }
  return nullptr;
}

}  // namespace zor2::xml
