#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace zor2::xml {

// An element of a document that the program builds and writes (the report, a
// described interface): a tag, attributes in the order they were set, and
// children that it owns, in the order they were added. Values are held as
// plain text; the writer escapes them.
class OutputElement {
 public:
  struct Attribute {
    std::string name;
    std::string value;
  };

  explicit OutputElement(std::string tag) : tag_(std::move(tag)) {}
  OutputElement(const OutputElement&) = delete;
  OutputElement& operator=(const OutputElement&) = delete;

  const std::string& tag() const { return tag_; }
  const std::vector<Attribute>& attributes() const { return attributes_; }
  const std::vector<std::unique_ptr<OutputElement>>& children() const { return children_; }

  // Adds attribute `name` at the end, or replaces the value of an existing one
  // where it stands.
  void SetAttribute(std::string_view name, std::string_view value);
  // The value of attribute `name`, or null when the element has none.
  const std::string* FindAttribute(std::string_view name) const;

  // Appends a new child `tag` and returns it; it lives as long as this element.
  OutputElement* AddChild(std::string tag);
  // Appends `child`, built apart, and returns it.
  OutputElement* AddChild(std::unique_ptr<OutputElement> child);

 private:
  std::string tag_;
  std::vector<Attribute> attributes_;
  std::vector<std::unique_ptr<OutputElement>> children_;
};

// Appends to `out` the document whose root is `root`: an XML declaration
// (UTF-8), then one element per line, indented by two spaces per level,
// attributes in their order with values escaped, a childless element closed
// as "<tag .../>".
void AppendDocument(const OutputElement& root, std::string* out);

// Writes the document whose root is `root` to `path`, atomically where the
// path allows it (WriteFileAtomically). False with the system's reason in
// `err` when it cannot be written.
bool WriteDocument(const OutputElement& root, const std::string& path, std::string* err);

}  // namespace zor2::xml
