#pragma once

#include <string_view>
#include <vector>

#include "platform/xml/document.h"

namespace zor2 {

// The direct children of `parent` whose tag is `tag`, in document order.
std::vector<const xml::Element*> ChildElements(const xml::Element& parent, std::string_view tag);

// The "File" children of those "Interfaces" children of `framework` whose
// "Name" is `group`, in document order; with a non-null `required_attribute`,
// only the files that carry it.
std::vector<const xml::Element*> GroupFiles(const xml::Element& framework, std::string_view group,
                                            const char* required_attribute);

}  // namespace zor2
