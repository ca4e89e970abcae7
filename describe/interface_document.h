#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "describe/interface_model.h"
#include "platform/xml/output_element.h"

namespace zor2::describe {

// The interface description document of `framework`: a "Workspace" root, one
// "Framework", its "Interfaces" groups, their "File", "Class", "Method" and
// "Arg" elements in the order of the description, each with the attributes
// that zor2check reads (optional ones only when they have a value).
// `text` as the document holds it: valid UTF-8 of characters that XML allows,
// every other byte written as "\xHH", whatever bytes a header holds.
std::string DocumentText(std::string_view text);

std::unique_ptr<xml::OutputElement> BuildDocument(const FrameworkDescription& framework);

}  // namespace zor2::describe
