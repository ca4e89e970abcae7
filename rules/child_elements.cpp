#include "rules/child_elements.h"

namespace zor2 {

std::vector<const xml::Element*> ChildElements(const xml::Element& parent, std::string_view tag) {
  std::vector<const xml::Element*> children;
  for (const xml::Element* child = parent.first_child(); child != nullptr;
       child = child->next_sibling()) {
    if (child->tag() == tag) children.push_back(child);
  }
  return children;
}

std::vector<const xml::Element*> GroupFiles(const xml::Element& framework, std::string_view group,
                                            const char* required_attribute) {
  std::vector<const xml::Element*> files;
  for (const xml::Element* interfaces : ChildElements(framework, "Interfaces")) {
    const char* name = interfaces->FindAttribute("Name");
    if (name == nullptr || name != group) continue;
    for (const xml::Element* file : ChildElements(*interfaces, "File")) {
      if (required_attribute == nullptr || file->FindAttribute(required_attribute) != nullptr) {
        files.push_back(file);
      }
    }
  }
  return files;
}

}  // namespace zor2
