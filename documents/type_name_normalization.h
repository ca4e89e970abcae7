#pragma once

#include <string>
#include <string_view>

namespace zor2 {

// Rewrites the spellings of the C long integer types in `value` into one
// portable name each ("unsigned long long" -> "QEXULONG64", "long int" ->
// "QEXLONG32", ...), keeping "long double" as it is, so that type comparisons
// see one spelling per type. Whole words only: "longer" is left alone.
//
// Follows the contract of a value rewrite (xml::ValueRewrite): when any
// rewriting step made a change, fills `rewritten` with the result and returns
// true; otherwise returns false and leaves `rewritten` alone. A value holding neither
// "long" nor "QEXDOUBLE128" (nearly every value) is rejected by a plain
// substring search, without copying.
bool NormalizeTypeNames(std::string_view value, std::string* rewritten);

// False for a value that NormalizeTypeNames surely leaves as it is: one that
// holds neither "long" nor "QEXDOUBLE128".
bool MayNormalizeTypeNames(std::string_view value);

// False for a value that NormalizeTypeNames surely did not make: one that holds
// neither a portable name ("QEX...") nor "long".
bool MayHoldNormalizedTypeNames(std::string_view value);

}  // namespace zor2
