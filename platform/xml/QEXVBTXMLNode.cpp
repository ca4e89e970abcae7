#include "platform/xml/QEXVBTXMLNode.h"

#include <cstdint>
#include <cstring>
#include <new>
#include <vector>

#include "platform/xml/DocumentFile.h"
#include "platform/xml/DocumentStorage.h"
#include "platform/xml/XMLReader.h"

// Representation. An element is 32 bytes: the virtual table pointer, its data
// (the tag, or its Extra), the next sibling (whose lowest bit tells which) and
// the first child. The elements of a parsed document but its root are placed
// in an arena of the document, and their tags and attributes are not copied:
// they stay in the document's buffer as the reader left them
// (DocumentStorage.h), so a parsed attribute costs nothing beyond its text.
// Extra holds all the rest: it is there for elements built with CreateNode
// (or a derived class), for the root of a parsed document (which owns the
// document's storage), for parsed elements whose attributes were set, and for
// parsed elements that were given children. It also remembers the previous
// sibling and the last child, so that appending and removing take O(1) for
// built elements, as in the report; a parsed element without them is found
// by a walk over its siblings.

static_assert(sizeof(void*) != 8 || sizeof(QEXVBTXMLNode) == 32);

struct QEXVBTXMLNode::Extra {
  struct Attribute {
    std::string name;
    const char* value;  // store.get(), or a value in a document's buffer
    std::unique_ptr<char[]> store;
  };
  const char* block;      // the tag, with a parsed element's attributes
  bool heap_node = true;  // false: the element lives in its document's arena
  bool owned = true;      // attributes in `attributes` rather than in block
  bool prev_known = false;
  bool last_known = true;
  QEXVBTXMLNode* prev = nullptr;        // the previous sibling, when prev_known
  QEXVBTXMLNode* last_child = nullptr;  // the last child, when last_known
  std::string tag;                      // the tag of a built element
  std::vector<Attribute> attributes;
  std::unique_ptr<ParsedDocument> document;  // on the root of a parsed document
};

struct QEXVBTXMLNode::RewritePass {
  // A rewritten value that has to wait for its block to be rebuilt.
  struct Grown {
    const char* name;
    const char* value;
    size_t offset;  // in grown_text
    size_t length;
  };
  QEXAttributeRewrite rewrite;
  // The document being rewritten, whose storage takes grown values; null for
  // a pass over elements that own their values or over part of a document.
  ParsedDocument* document;
  std::string scratch;
  std::string grown_text;
  std::vector<Grown> grown;
};

namespace {

// CreateNode's element: the protected constructor made reachable to
// std::make_unique.
class BuiltNode final : public QEXVBTXMLNode {
 public:
  explicit BuiltNode(const char* tag) : QEXVBTXMLNode(tag) {}
};

std::unique_ptr<char[]> CopyString(std::string_view text) {
  auto copy = std::make_unique_for_overwrite<char[]>(text.size() + 1);
  std::memcpy(copy.get(), text.data(), text.size());
  copy[text.size()] = '\0';
  return copy;
}

// Values are zero-terminated strings: a rewritten text ends at its first zero.
std::string_view UpToZero(const std::string& text) {
  return std::string_view(text.data(), std::strlen(text.c_str()));
}

}  // namespace

QEXVBTXMLNode::QEXVBTXMLNode(const char* tag) : next_(kHasExtra) {
  auto extra = std::make_unique<Extra>();
  extra->tag = tag != nullptr ? tag : "";
  extra->block = extra->tag.c_str();
  data_ = extra.release();  // owned through next_'s kHasExtra
}

QEXVBTXMLNode::QEXVBTXMLNode(const char* block, ParsedTag) noexcept : data_(block), next_(0) {}

QEXVBTXMLNode::~QEXVBTXMLNode() {
  QEXVBTXMLNode* first = first_child_;
  first_child_ = nullptr;
  DiscardList(first);
  std::unique_ptr<Extra> discarded(extra());
}

QEXVBTXMLNode::Extra* QEXVBTXMLNode::extra() const {
  return (next_ & kHasExtra) != 0 ? static_cast<Extra*>(const_cast<void*>(data_)) : nullptr;
}

// Gives a parsed element its Extra, which takes over its block.
QEXVBTXMLNode::Extra& QEXVBTXMLNode::EnsureExtra() {
  if (Extra* extra = this->extra()) return *extra;
  auto extra = std::make_unique<Extra>();
  extra->block = static_cast<const char*>(data_);
  extra->heap_node = false;
  extra->owned = false;
  extra->last_known = false;
  data_ = extra.release();
  next_ |= kHasExtra;
  return *static_cast<Extra*>(const_cast<void*>(data_));
}

const char* QEXVBTXMLNode::block() const {
  Extra* extra = this->extra();
  return extra != nullptr ? extra->block : static_cast<const char*>(data_);
}

void QEXVBTXMLNode::SetBlock(const char* block) {
  if (Extra* extra = this->extra()) {
    extra->block = block;
  } else {
    data_ = block;
  }
}

bool QEXVBTXMLNode::IsHeapNode() const {
  Extra* extra = this->extra();
  return extra != nullptr && extra->heap_node;
}

bool QEXVBTXMLNode::OwnsDocument() const {
  Extra* extra = this->extra();
  return extra != nullptr && extra->document != nullptr;
}

// Discards a chain of siblings and all their descendants without recursion:
// the children of each discarded element are spliced in front of the rest of
// the chain.
void QEXVBTXMLNode::DiscardList(QEXVBTXMLNode* first) {
  QEXVBTXMLNode* pending = first;
  while (pending != nullptr) {
    QEXVBTXMLNode* node = pending;
    pending = node->next();
    // A document root discards its own subtree, which lives in its arena.
    if (node->first_child_ != nullptr && !node->OwnsDocument()) {
      QEXVBTXMLNode* last = node->first_child_;
      while (last->next() != nullptr) last = last->next();
      last->SetNext(pending);
      pending = node->first_child_;
      node->first_child_ = nullptr;
    }
    if (node->IsHeapNode()) {
      std::unique_ptr<QEXVBTXMLNode> discarded(node);
    } else if (node->extra() != nullptr) {
      // Other arena elements hold nothing; their memory goes with the arena.
      std::destroy_at(node);
    }
  }
}

std::unique_ptr<QEXVBTXMLNode> QEXVBTXMLNode::CreateFromFile(const char* path,
                                                             XMLReadError& error) {
  return XMLReader::ReadFile(path, error);
}

std::unique_ptr<QEXVBTXMLNode> QEXVBTXMLNode::CreateFromText(std::string_view text,
                                                             XMLReadError& error) {
  return XMLReader::ReadText(text, error);
}

std::unique_ptr<QEXVBTXMLNode> QEXVBTXMLNode::CreateNode(const char* tag) {
  return std::make_unique<BuiltNode>(tag);
}

QEXVBTXMLNode* QEXVBTXMLNode::NewParsedNode(Arena& nodes, const char* block) {
  void* memory = nodes.Allocate(sizeof(QEXVBTXMLNode), alignof(QEXVBTXMLNode));
  return ::new (memory) QEXVBTXMLNode(block, ParsedTag{});
}

void QEXVBTXMLNode::AdoptDocument(std::unique_ptr<ParsedDocument> document) {
  extra()->document = std::move(document);
}

// The reader appends the root's children on its own.
void QEXVBTXMLNode::SetParsedBlock(const char* block) {
  Extra* extra = this->extra();
  extra->block = block;
  extra->owned = false;
  extra->last_known = false;
}

const char* QEXVBTXMLNode::getTag() const {
  return block();
}

const char* QEXVBTXMLNode::getAttributeValue(const char* name, const void*) const {
  if (name == nullptr) return nullptr;
  Extra* extra = this->extra();
  if (extra == nullptr) return FindBlockValue(static_cast<const char*>(data_), name);
  if (!extra->owned) return FindBlockValue(extra->block, name);
  for (const Extra::Attribute& attribute : extra->attributes) {
    if (std::strcmp(attribute.name.c_str(), name) == 0) return attribute.value;
  }
  return nullptr;
}

void QEXVBTXMLNode::getAttributeValues(std::span<const std::string_view> names,
                                       std::span<const char*> values) const {
  for (size_t i = 0; i < names.size(); ++i) values[i] = nullptr;
  // Each attribute fills the slot of its name, if asked for. Callers mostly
  // ask in the order in which elements hold their attributes, so the search
  // starts after the name found last.
  size_t next = 0;
  auto take = [&names, &values, &next](std::string_view name, const char* value) {
    for (size_t k = 0; k < names.size(); ++k) {
      const size_t i = next + k < names.size() ? next + k : next + k - names.size();
      if (names[i] == name) {
        values[i] = value;
        next = i + 1;
        return;
      }
    }
  };
  Extra* extra = this->extra();
  if (extra != nullptr && extra->owned) {
    for (const Extra::Attribute& attribute : extra->attributes)
      take(attribute.name, attribute.value);
    return;
  }
  BlockAttributes walk(block());
  std::string_view name;
  std::string_view value;
  const char* slot;
  while (walk.Next(name, value, slot)) take(name, value.data());
}

void QEXVBTXMLNode::setAttributeValue(const char* name, const char* value) {
  if (name == nullptr) return;
  SetOwnedValue(name, value != nullptr ? value : "");
}

// Moves the attributes of a parsed element out of its block into owned
// storage; values keep pointing into the document until they are set.
QEXVBTXMLNode::Extra& QEXVBTXMLNode::OwnedAttributes() {
  Extra& extra = EnsureExtra();
  if (!extra.owned) {
    BlockAttributes walk(extra.block);
    const char* name;
    const char* value;
    while (walk.Next(name, value)) extra.attributes.push_back({name, value, nullptr});
    extra.owned = true;
  }
  return extra;
}

void QEXVBTXMLNode::SetOwnedValue(const char* name, std::string_view value) {
  Extra& extra = OwnedAttributes();
  for (Extra::Attribute& attribute : extra.attributes) {
    if (attribute.name == name) {
      attribute.store = CopyString(value);
      attribute.value = attribute.store.get();
      return;
    }
  }
  Extra::Attribute& attribute = extra.attributes.emplace_back();
  attribute.name = name;
  attribute.store = CopyString(value);
  attribute.value = attribute.store.get();
}

QEXVBTXMLNode* QEXVBTXMLNode::LastChild() {
  Extra& extra = EnsureExtra();
  if (!extra.last_known) {
    QEXVBTXMLNode* last = first_child_;
    while (last != nullptr && last->next() != nullptr) last = last->next();
    extra.last_child = last;
    extra.last_known = true;
  }
  return extra.last_child;
}

QEXVBTXMLNode* QEXVBTXMLNode::insertNodeAtEnd(std::unique_ptr<QEXVBTXMLNode> child) {
  if (child == nullptr) return nullptr;
  QEXVBTXMLNode* node = child.release();
  QEXVBTXMLNode* last = LastChild();
  node->SetNext(nullptr);
  AppendParsed(this, last, node);
  extra()->last_child = node;
  Extra* child_extra = node->extra();  // a heap element always has one
  child_extra->prev = last;
  child_extra->prev_known = true;
  return node;
}

// The sibling before `child`, or null for the first child. `is_child` is
// false when `child` is not a child of this element at all.
QEXVBTXMLNode* QEXVBTXMLNode::PreviousSibling(QEXVBTXMLNode* child, bool& is_child) const {
  is_child = true;
  Extra* child_extra = child->extra();
  if (child_extra != nullptr && child_extra->prev_known) return child_extra->prev;
  QEXVBTXMLNode* prev = nullptr;
  for (QEXVBTXMLNode* node = first_child_; node != child; node = node->next()) {
    if (node == nullptr) {
      is_child = false;
      return nullptr;
    }
    prev = node;
  }
  return prev;
}

void QEXVBTXMLNode::removeNode(QEXVBTXMLNode* child) {
  if (child == nullptr) return;
  bool is_child;
  QEXVBTXMLNode* prev = PreviousSibling(child, is_child);
  if (!is_child) return;
  QEXVBTXMLNode* next = child->next();
  if (prev != nullptr) {
    prev->SetNext(next);
  } else {
    first_child_ = next;
  }
  if (next != nullptr) {
    Extra* next_extra = next->extra();
    if (next_extra != nullptr && next_extra->prev_known) next_extra->prev = prev;
  }
  Extra* extra = this->extra();
  if (extra != nullptr && extra->last_known && extra->last_child == child) {
    extra->last_child = prev;
  }
  child->SetNext(nullptr);
  DiscardList(child);
}

QEXVBTXMLPosition QEXVBTXMLNode::getFirstNodePosition(const void*) const {
  return first_child_;
}

QEXVBTXMLNode* QEXVBTXMLNode::getNextNode(QEXVBTXMLPosition& position, const void*) const {
  if (position == nullptr) return nullptr;
  auto* node = static_cast<QEXVBTXMLNode*>(const_cast<void*>(position));
  position = node->next();
  return node;
}

template <typename Node, typename Enter, typename Leave>
void QEXVBTXMLNode::WalkInDocumentOrder(Node* root, Enter enter, Leave leave) {
  // `open` holds the ancestors of `node` below `root`, and `root` itself.
  std::vector<Node*> open;
  Node* node = root;
  for (;;) {
    enter(node, open.size());
    if (node->first_child_ != nullptr) {
      open.push_back(node);
      node = node->first_child_;
      continue;
    }
    for (;;) {
      if (open.empty()) return;
      if (node->next() != nullptr) {
        node = node->next();
        break;
      }
      node = open.back();
      open.pop_back();
      leave(node, open.size());
    }
  }
}

void changeAttributeValues(QEXVBTXMLNode* root, QEXAttributeRewrite rewrite) {
  if (root == nullptr || rewrite == nullptr) return;
  QEXVBTXMLNode::RewritePass pass{rewrite, nullptr, {}, {}, {}};
  if (root->OwnsDocument()) pass.document = root->extra()->document.get();
  QEXVBTXMLNode::WalkInDocumentOrder(
      root, [&pass](QEXVBTXMLNode* node, size_t) { node->RewriteValues(pass); },
      [](QEXVBTXMLNode*, size_t) {});
}

void QEXVBTXMLNode::RewriteValues(RewritePass& pass) {
  Extra* extra = this->extra();
  if (extra == nullptr || !extra->owned) {
    RewriteBlock(pass);
    return;
  }
  for (Extra::Attribute& attribute : extra->attributes) {
    pass.scratch.clear();
    if (pass.rewrite(attribute.value, pass.scratch) == 0) continue;
    attribute.store = CopyString(UpToZero(pass.scratch));
    attribute.value = attribute.store.get();
  }
}

namespace {

// Gives a grown value a new home in the spare capacity after the document's
// text and points its slot there. False when the slot is too small to point
// (values under three characters) or the spare capacity is used up.
bool MoveValue(ParsedDocument& document, char* slot, size_t room, std::string_view text) {
  bool moved = *slot == kMovedValue;
  if (!moved && room + 2 < kMovedValueSlot) return false;
  char* target = document.AllocateSpare(text.size() + 1);
  // A rebuilt block lives elsewhere in memory: its slots may be out of reach.
  if (target == nullptr || target - slot > INT32_MAX || target - slot < INT32_MIN) return false;
  std::memcpy(target, text.data(), text.size());
  target[text.size()] = '\0';
  if (!moved) {
    // The quote, the value and its zero: room + 2 bytes.
    std::memset(slot + kMovedValueSlot, 0, room + 2 - kMovedValueSlot);
    *slot = kMovedValue;
  }
  int32_t offset = static_cast<int32_t>(target - slot);
  std::memcpy(slot + 1, &offset, sizeof offset);
  return true;
}

}  // namespace

// A value that fits its slot in the block is rewritten in place (padded with
// zero bytes); one that grew moves to the document's spare capacity, or, when
// it cannot, waits for the block to be rebuilt.
void QEXVBTXMLNode::RewriteBlock(RewritePass& pass) {
  pass.grown.clear();
  pass.grown_text.clear();
  BlockAttributes walk(block());
  std::string_view name;
  std::string_view value;
  const char* slot;
  while (walk.Next(name, value, slot)) {
    pass.scratch.clear();
    if (pass.rewrite(value, pass.scratch) == 0) continue;
    std::string_view text = UpToZero(pass.scratch);
    size_t room = value.size();
    if (text.size() <= room) {
      char* place = const_cast<char*>(value.data());  // the document's own buffer
      std::memcpy(place, text.data(), text.size());
      std::memset(place + text.size(), 0, room - text.size());
      continue;
    }
    if (pass.document != nullptr &&
        MoveValue(*pass.document, const_cast<char*>(slot), room, text)) {
      continue;
    }
    pass.grown.push_back({name.data(), value.data(), pass.grown_text.size(), text.size()});
    pass.grown_text += text;
  }
  if (!pass.grown.empty()) RebuildBlock(pass);
}

// Writes a new block holding the grown values into the document's string
// arena. The old block stays where it is, so values handed out before remain
// readable. Without a document (a pass over part of one) the element takes
// its values into owned storage instead.
void QEXVBTXMLNode::RebuildBlock(RewritePass& pass) {
  auto grown_value = [&pass](const RewritePass::Grown& grown) {
    return std::string_view(pass.grown_text).substr(grown.offset, grown.length);
  };
  if (pass.document == nullptr) {
    for (const RewritePass::Grown& grown : pass.grown)
      SetOwnedValue(grown.name, grown_value(grown));
    return;
  }
  const char* old_block = block();
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
  char* block = static_cast<char*>(pass.document->strings.Allocate(size, 1));
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
    put(grew ? grown_value(pass.grown[next++]) : std::string_view(value));
    *out++ = '\0';
  }
  *out = '>';
  SetBlock(block);
}

void QEXVBTXMLNode::AppendStartTag(std::string& out) const {
  out += '<';
  out += block();
  auto put = [&out](const char* name, const char* value) {
    out += ' ';
    out += name;
    out += "=\"";
    out += value;
    out += '"';
  };
  Extra* extra = this->extra();
  if (extra != nullptr && extra->owned) {
    for (const Extra::Attribute& attribute : extra->attributes) {
      put(attribute.name.c_str(), attribute.value);
    }
    return;
  }
  BlockAttributes walk(block());
  const char* name;
  const char* value;
  while (walk.Next(name, value)) put(name, value);
}

void QEXVBTXMLNode::writeTo(std::string& out) const {
  out += "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n";
  WalkInDocumentOrder(
      this,
      [&out](const QEXVBTXMLNode* node, size_t depth) {
        out.append(depth * 2, ' ');
        node->AppendStartTag(out);
        out += node->first_child_ != nullptr ? ">\n" : "/>\n";
      },
      [&out](const QEXVBTXMLNode* node, size_t depth) {
        out.append(depth * 2, ' ');
        out += "</";
        out += node->block();
        out += ">\n";
      });
}

int QEXVBTXMLNode::writeInFile(const char* path, std::string& error) const {
  std::string text;
  writeTo(text);
  return WriteDocumentFile(path, text, error);
}
