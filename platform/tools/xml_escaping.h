#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace zor2 {

// Appends `value` to `out` as the text of an XML attribute value: "&", "<",
// ">", '"' and "'" as the five predefined entities, and tab, line feed and
// carriage return as "&#9;", "&#10;" and "&#13;", so that a reader gets the
// value back exactly.
void AppendEscaped(std::string_view value, std::string* out);

// Decodes the five predefined entities and decimal ("&#65;") and hexadecimal
// ("&#x41;") character references into UTF-8, in one pass (decoded text is
// not decoded again). Anything else, including a reference to a code point
// that is not a Unicode scalar value, is left as it stands. When `value`
// holds something to decode, fills `rewritten` and returns true; otherwise
// returns false and leaves `rewritten` alone.
bool DecodeXmlReferences(std::string_view value, std::string* rewritten);

// Decodes the one reference that `after_amp` (the text after an "&") begins
// with, as DecodeXmlReferences would, appending what it stands for to `out`.
// Returns the length of the reference's text after the "&", or 0 (and appends
// nothing) when there is none to decode there.
size_t AppendDecodedReference(std::string_view after_amp, std::string* out);

}  // namespace zor2
