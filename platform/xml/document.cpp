#include "platform/xml/document.h"

#include <sys/mman.h>
#include <unistd.h>

#include <algorithm>
#include <cstring>
#include <functional>
#include <new>
#include <string>
#include <type_traits>
#include <vector>

namespace zor2::xml {

static_assert(sizeof(void*) != 8 || sizeof(Element) == 12);
static_assert(std::is_trivially_destructible_v<Element>, "elements are unmapped, not destroyed");

ElementStore::~ElementStore() {
  if (elements_ != nullptr) ::munmap(elements_, capacity_ * sizeof(Element));
}

size_t ElementStore::Add(const char* block) {
  if (size_ == capacity_) {
    // Whole pages, doubled each time; the links are distances, so moving the
    // pages moves nothing else.
    const size_t page = static_cast<size_t>(::sysconf(_SC_PAGESIZE));
    const size_t old_bytes = capacity_ * sizeof(Element);
    const size_t new_bytes = old_bytes == 0 ? 16 * page : 2 * old_bytes;
    void* grown = elements_ == nullptr ? ::mmap(nullptr, new_bytes, PROT_READ | PROT_WRITE,
                                                MAP_PRIVATE | MAP_ANONYMOUS, -1, 0)
                                       : ::mremap(elements_, old_bytes, new_bytes, MREMAP_MAYMOVE);
    if (grown == MAP_FAILED || size_ >= (size_t{1} << 31)) throw std::bad_alloc();
    elements_ = static_cast<Element*>(grown);
    capacity_ = new_bytes / sizeof(Element);
  }
  ::new (&elements_[size_]) Element(block);
  return size_++;
}

void Element::FindAttributes(std::span<const std::string_view> names,
                             std::span<const char*> values) const {
  for (size_t i = 0; i < names.size(); ++i) values[i] = nullptr;
  // Each attribute fills the slot of its name, if asked for. The search
  // starts after the name found last, since callers mostly ask in the order
  // in which elements hold their attributes.
  size_t next = 0;
  BlockAttributes walk(block());
  std::string_view name;
  std::string_view value;
  while (walk.Next(name, value)) {
    for (size_t k = 0; k < names.size(); ++k) {
      const size_t i = next + k < names.size() ? next + k : next + k - names.size();
      if (names[i] == name) {
        values[i] = value.data();
        next = i + 1;
        break;
      }
    }
  }
}

char* Document::PlaceBlock(std::string_view block, char*& out, const char* limit) {
  char* place;
  if (block.size() <= static_cast<size_t>(limit - out)) {
    place = out;
    out += block.size();
  } else {
    place = static_cast<char*>(blocks_.Allocate(block.size(), 1));
  }
  std::memcpy(place, block.data(), block.size());
  return place;
}

void OriginalValues::Add(const char* value, std::string_view original, bool in_text) {
  constexpr size_t kChunkSize = size_t{1} << 20;
  if (original.size() + 1 > left_) {
    left_ = std::max(kChunkSize, original.size() + 1);
    chunks_.push_back(std::make_unique_for_overwrite<char[]>(left_));
    next_ = chunks_.back().get();
  }
  std::memcpy(next_, original.data(), original.size());
  next_[original.size()] = '\0';
  (in_text ? in_text_ : out_of_line_).push_back({value, next_});
  next_ += original.size() + 1;
  left_ -= original.size() + 1;
}

void OriginalValues::Seal() {
  // Places are compared as addresses, which std::less orders totally.
  auto before = [](const Entry& a, const Entry& b) {
    return std::less<const char*>()(a.value, b.value);
  };
  for (std::deque<Entry>* run : {&in_text_, &out_of_line_}) {
    if (!std::is_sorted(run->begin(), run->end(), before)) {
      std::sort(run->begin(), run->end(), before);
    }
  }
}

void OriginalValues::Clear() {
  in_text_.clear();
  out_of_line_.clear();
  chunks_.clear();
  next_ = nullptr;
  left_ = 0;
}

std::optional<std::string_view> OriginalValues::Find(const char* value) const {
  if (may_be_kept_ != nullptr && !may_be_kept_(value)) return std::nullopt;
  for (const std::deque<Entry>* run : {&in_text_, &out_of_line_}) {
    auto entry = std::lower_bound(
        run->begin(), run->end(), value,
        [](const Entry& e, const char* v) { return std::less<const char*>()(e.value, v); });
    if (entry != run->end() && entry->value == value) return std::string_view(entry->original);
  }
  return std::nullopt;
}

// Each block whose values change is written anew: in its own place when it
// does not grow, else in the block arena.
void Document::RewriteValues(ValueRewrite rewrite, OriginalValues* originals) {
  if (originals != nullptr) originals->Clear();  // the values as this pass finds them
  std::string block;
  std::string rewritten;
  struct Kept {
    size_t offset;         // of the value in `block`
    std::string original;  // copied: the old block may be overwritten
  };
  std::vector<Kept> kept;
  // The array is in document order.
  for (size_t i = 0; i < elements_.size(); ++i) {
    Element* element = &elements_[i];
    const char* old_block = element->block();
    block.assign(old_block, std::strlen(old_block) + 1);
    kept.clear();
    bool changed = false;
    BlockAttributes walk(old_block);
    std::string_view name;
    std::string_view value;
    while (walk.Next(name, value)) {
      block.append(name.data(), name.size() + 1);
      std::string_view text = value;
      rewritten.clear();
      if (rewrite(value, &rewritten)) {
        text = std::string_view(rewritten.c_str());  // up to its first zero byte
        changed = true;
        if (originals != nullptr && originals->WorthKeeping(value)) {
          kept.push_back({block.size(), std::string(value)});
        }
      }
      block.append(text.data(), text.size());
      block.push_back('\0');
    }
    block.push_back(kBlockEnd);
    if (changed) {
      char* in_place = const_cast<char*>(old_block);  // the document's own memory
      const char* old_end = walk.position() + 1;
      const char* placed = PlaceBlock(block, in_place, old_end);
      element->set_block(placed);
      for (const Kept& k : kept) originals->Add(placed + k.offset, k.original, placed == old_block);
    }
  }
  if (originals != nullptr) originals->Seal();
}

}  // namespace zor2::xml
