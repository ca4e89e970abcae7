#include "platform/xml/output_element.h"

#include "platform/tools/file_output.h"
#include "platform/tools/xml_escaping.h"

namespace zor2::xml {

void OutputElement::SetAttribute(std::string_view name, std::string_view value) {
  for (Attribute& attribute : attributes_) {
    if (attribute.name == name) {
      attribute.value = value;
      return;
    }
  }
  attributes_.push_back({std::string(name), std::string(value)});
}

const std::string* OutputElement::FindAttribute(std::string_view name) const {
  for (const Attribute& attribute : attributes_) {
    if (attribute.name == name) return &attribute.value;
  }
  return nullptr;
}

OutputElement* OutputElement::AddChild(std::string tag) {
  return AddChild(std::make_unique<OutputElement>(std::move(tag)));
}

OutputElement* OutputElement::AddChild(std::unique_ptr<OutputElement> child) {
  children_.push_back(std::move(child));
  return children_.back().get();
}

namespace {

void AppendStartTag(const OutputElement& element, std::string* out) {
  *out += '<';
  *out += element.tag();
  for (const OutputElement::Attribute& attribute : element.attributes()) {
    *out += ' ';
    *out += attribute.name;
    *out += "=\"";
    AppendEscaped(attribute.value, out);
    *out += '"';
  }
}

}  // namespace

// Iterative, so that the depth of a tree never bounds what can be written.
void AppendDocument(const OutputElement& root, std::string* out) {
  *out += "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n";
  struct Open {
    const OutputElement* element;
    size_t next_child;
  };
  std::vector<Open> open;
  auto enter = [&open, out](const OutputElement& element) {
    out->append(open.size() * 2, ' ');
    AppendStartTag(element, out);
    if (element.children().empty()) {
      *out += "/>\n";
      return;
    }
    *out += ">\n";
    open.push_back({&element, 0});
  };
  enter(root);
  while (!open.empty()) {
    Open& top = open.back();
    if (top.next_child < top.element->children().size()) {
      enter(*top.element->children()[top.next_child++]);
      continue;
    }
    const OutputElement* finished = top.element;
    open.pop_back();
    out->append(open.size() * 2, ' ');
    *out += "</";
    *out += finished->tag();
    *out += ">\n";
  }
}

bool WriteDocument(const OutputElement& root, const std::string& path, std::string* err) {
  std::string text;
  AppendDocument(root, &text);
  return WriteFileAtomically(path, text, nullptr, err);
}

}  // namespace zor2::xml
