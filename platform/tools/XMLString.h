#pragma once

#include <string>
#include <string_view>

// Both functions follow the attribute-rewrite contract of
// changeAttributeValues: when `value` needs rewriting they fill `rewritten`
// with the new text and return 1; otherwise they return 0 and leave
// `rewritten` alone, at the cost of one scan of `value`.

// Escapes "&", "<", ">", '"' and "'" as the five predefined entities, and tab,
// line feed and carriage return as "&#9;", "&#10;" and "&#13;", so that a
// reader gets the value back exactly.
int encodeXMLString(std::string_view value, std::string& rewritten);

// Decodes the five predefined entities and decimal ("&#65;") and hexadecimal
// ("&#x41;") character references into UTF-8. Anything else, including a
// reference to a code point that is not a Unicode scalar value, is left as it
// stands.
int decodeXMLString(std::string_view value, std::string& rewritten);
