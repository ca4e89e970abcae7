#pragma once

#include <string>
#include <string_view>

namespace zor2 {

// Prepares one attribute value of an input document for the rules, as a value
// rewrite (xml::ValueRewrite): the spellings of the long integer types are
// normalised as NormalizeTypeNames does, then entity and character references
// are decoded as DecodeXmlReferences does, so that the normalisation only ever
// sees the text as written in the document. Both steps are made in one scan
// from one candidate ("&", "long", "QEXDOUBLE128") to the next, which
// writes into `rewritten` only for a value that changes, reusing its capacity.
bool PrepareValue(std::string_view value, std::string* rewritten);

}  // namespace zor2
