#include "platform/xml/document_storage.h"

#include <algorithm>

namespace zor2::xml {
namespace {

// Chunks grow geometrically so that small documents stay small and large ones
// do not pay one allocation per few elements.
constexpr size_t kMaxChunkSize = size_t{1} << 20;

}  // namespace

TextBuffer TextBuffer::Allocate(size_t size, size_t spare) {
  TextBuffer text;
  text.capacity = size + 1 + spare;
  text.bytes = std::make_unique_for_overwrite<char[]>(text.capacity);
  text.size = size;
  text.bytes[size] = '\0';
  return text;
}

void* Arena::AllocateInNewChunk(size_t size, size_t align) {
  size_t needed = size + align;
  // A large request gets a chunk of its own, so that the current chunk keeps
  // serving small ones.
  if (needed > chunk_size_ / 4) {
    chunks_.push_back(std::make_unique_for_overwrite<std::byte[]>(needed));
    std::byte* start = chunks_.back().get();
    size_t pad = (0 - reinterpret_cast<uintptr_t>(start)) & (align - 1);
    return start + pad;
  }
  chunks_.push_back(std::make_unique_for_overwrite<std::byte[]>(chunk_size_));
  next_ = chunks_.back().get();
  left_ = chunk_size_;
  chunk_size_ = std::min(chunk_size_ * 2, kMaxChunkSize);
  return Allocate(size, align);
}

}  // namespace zor2::xml
