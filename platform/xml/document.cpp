#include "platform/xml/document.h"

#include <algorithm>
#include <climits>
#include <cstdint>
#include <cstring>
#include <functional>
#include <iterator>
#include <new>
#include <vector>

namespace zor2::xml {

// Three pointers: a parsed attribute costs nothing beyond its text, and an
// element nothing beyond this.
static_assert(sizeof(void*) != 8 || sizeof(Element) == 24);

void Element::FindAttributes(std::span<const std::string_view> names,
                             std::span<const char*> values) const {
  for (size_t i = 0; i < names.size(); ++i) values[i] = nullptr;
  // Each attribute fills the slot of its name, if asked for. The search
  // starts after the name found last, since callers mostly ask in the order
  // in which elements hold their attributes.
  size_t next = 0;
  BlockAttributes walk(block_);
  std::string_view name;
  std::string_view value;
  const char* slot;
  while (walk.Next(name, value, slot)) {
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

// A value rewrite over a whole document, with its scratch space.
struct Document::RewritePass {
  // A rewritten value that has to wait for its block to be rebuilt.
  struct Grown {
    const char* value;
    size_t offset;  // in grown_text
    size_t length;
  };
  ValueRewrite rewrite;
  OriginalValues* originals;
  // Whether the original of a changed value goes into `originals`.
  bool Keeps(std::string_view original) const {
    return originals != nullptr &&
           (originals->worth_keeping_ == nullptr || originals->worth_keeping_(original));
  }
  std::string scratch;
  std::string grown_text;
  std::vector<Grown> grown;
};

Element* Document::NewElement(const char* block) {
  void* memory = elements_.Allocate(sizeof(Element), alignof(Element));
  return ::new (memory) Element(block);
}

char* Document::AllocateSpare(size_t size) {
  size_t offset = text_.size + 1 + spare_used_;
  if (size > text_.capacity - offset) return nullptr;
  spare_used_ += size;
  return text_.data() + offset;
}

void OriginalValues::Add(const char* value, std::string_view original, bool in_place) {
  constexpr size_t kChunkSize = size_t{1} << 20;
  if (original.size() + 1 > left_) {
    left_ = std::max(kChunkSize, original.size() + 1);
    chunks_.push_back(std::make_unique_for_overwrite<char[]>(left_));
    next_ = chunks_.back().get();
  }
  std::memcpy(next_, original.data(), original.size());
  next_[original.size()] = '\0';
  (in_place ? in_place_ : moved_).push_back({value, next_});
  next_ += original.size() + 1;
  left_ -= original.size() + 1;
}

void OriginalValues::Seal() {
  // Places are compared as addresses, which std::less orders totally.
  auto before = [](const Entry& a, const Entry& b) {
    return std::less<const char*>()(a.value, b.value);
  };
  if (!std::is_sorted(in_place_.begin(), in_place_.end(), before)) {
    std::sort(in_place_.begin(), in_place_.end(), before);
  }
  if (!std::is_sorted(moved_.begin(), moved_.end(), before)) {
    std::sort(moved_.begin(), moved_.end(), before);
  }
}

void OriginalValues::Clear() {
  in_place_.clear();
  moved_.clear();
  chunks_.clear();
  next_ = nullptr;
  left_ = 0;
}

std::optional<std::string_view> OriginalValues::Find(const char* value) const {
  if (may_be_kept_ != nullptr && !may_be_kept_(value)) return std::nullopt;
  for (const std::deque<Entry>* run : {&in_place_, &moved_}) {
    auto entry = std::lower_bound(
        run->begin(), run->end(), value,
        [](const Entry& e, const char* v) { return std::less<const char*>()(e.value, v); });
    if (entry != run->end() && entry->value == value) return std::string_view(entry->original);
  }
  return std::nullopt;
}

void Document::RewriteValues(ValueRewrite rewrite, OriginalValues* originals) {
  RewritePass pass{rewrite, originals, {}, {}, {}};
  if (originals != nullptr) {
    // The originals are the values as this pass found them.
    originals->Clear();
  }
  RewriteAll(pass);
  if (originals != nullptr) originals->Seal();
}

void Document::RewriteAll(RewritePass& pass) {
  // Document order, without recursion: `open` holds the ancestors of
  // `element`.
  std::vector<Element*> open;
  Element* element = root_;
  for (;;) {
    RewriteElement(*element, pass);
    if (element->first_child_ != nullptr) {
      open.push_back(element);
      element = element->first_child_;
      continue;
    }
    while (element->next_ == nullptr) {
      if (open.empty()) return;
      element = open.back();
      open.pop_back();
    }
    element = element->next_;
  }
}

namespace {

// Values are zero-terminated strings: a rewritten text ends at its first zero.
std::string_view UpToZero(const std::string& text) {
  return std::string_view(text.data(), std::strlen(text.c_str()));
}

}  // namespace

// A value that fits its slot in the block is rewritten in place (padded with
// zero bytes); one that grew moves to the spare capacity after the text, or,
// when it cannot, waits for the block to be rebuilt.
void Document::RewriteElement(Element& element, RewritePass& pass) {
  pass.grown.clear();
  pass.grown_text.clear();
  BlockAttributes walk(element.block_);
  std::string_view name;
  std::string_view value;
  const char* slot;
  while (walk.Next(name, value, slot)) {
    pass.scratch.clear();
    if (!pass.rewrite(value, &pass.scratch)) continue;
    std::string_view text = UpToZero(pass.scratch);
    size_t room = value.size();
    if (text.size() <= room) {
      if (pass.Keeps(value)) pass.originals->Add(value.data(), value, true);
      char* place = const_cast<char*>(value.data());  // the document's own buffer
      std::memcpy(place, text.data(), text.size());
      std::memset(place + text.size(), 0, room - text.size());
      continue;
    }
    // Moving overwrites the start of the slot, so the original is kept first
    // and given its new place after.
    const bool keep = pass.Keeps(value);
    if (keep) pass.originals->Add(nullptr, value, false);
    if (const char* moved = MoveValue(const_cast<char*>(slot), room, text)) {
      if (keep) pass.originals->moved_.back().value = moved;
      continue;
    }
    if (keep) pass.originals->moved_.pop_back();
    pass.grown.push_back({value.data(), pass.grown_text.size(), text.size()});
    pass.grown_text += text;
  }
  if (!pass.grown.empty()) RebuildBlock(element, pass);
}

// Gives a grown value a new home in the spare capacity after the text and
// points its slot there. False when the slot is too small to point (values
// under three characters) or the spare capacity is used up.
const char* Document::MoveValue(char* slot, size_t room, std::string_view text) {
  bool moved = *slot == kMovedValue;
  if (!moved && room + 2 < kMovedValueSlot) return nullptr;
  char* target = AllocateSpare(text.size() + 1);
  // A rebuilt block lives elsewhere in memory: its slots may be out of reach.
  if (target == nullptr || target - slot > INT32_MAX || target - slot < INT32_MIN) return nullptr;
  std::memcpy(target, text.data(), text.size());
  target[text.size()] = '\0';
  if (!moved) {
    // The quote, the value and its zero: room + 2 bytes.
    std::memset(slot + kMovedValueSlot, 0, room + 2 - kMovedValueSlot);
    *slot = kMovedValue;
  }
  int32_t offset = static_cast<int32_t>(target - slot);
  std::memcpy(slot + 1, &offset, sizeof offset);
  return target;
}

// Writes a new block holding the grown values into the block arena. The old
// block stays where it is, so values handed out before remain readable.
void Document::RebuildBlock(Element& element, RewritePass& pass) {
  auto grown_value = [&pass](const RewritePass::Grown& grown) {
    return std::string_view(pass.grown_text).substr(grown.offset, grown.length);
  };
  const char* old_block = element.block_;
  size_t tag_size = std::strlen(old_block) + 1;
  size_t size = tag_size + 1;  // the tag, its zero and the closing ">"
  BlockAttributes sizing(old_block);
  const char* name;
  const char* value;
  size_t next = 0;
  while (sizing.Next(name, value)) {
    bool grew = next < pass.grown.size() && pass.grown[next].value == value;
    size += std::strlen(name) + 3 + (grew ? pass.grown[next++].length : std::strlen(value));
  }
  char* block = static_cast<char*>(blocks_.Allocate(size, 1));
  char* out = block;
  auto put = [&out](std::string_view text) {
    std::memcpy(out, text.data(), text.size());
    out += text.size();
  };
  put(std::string_view(old_block, tag_size));
  BlockAttributes copying(old_block);
  next = 0;
  while (copying.Next(name, value)) {
    bool grew = next < pass.grown.size() && pass.grown[next].value == value;
    put(std::string_view(name, std::strlen(name) + 1));
    *out++ = '"';
    if (grew && pass.Keeps(value)) pass.originals->Add(out, value, false);
    put(grew ? grown_value(pass.grown[next++]) : std::string_view(value));
    *out++ = '\0';
  }
  *out = '>';
  element.block_ = block;
}

}  // namespace zor2::xml
