#pragma once

#include <string>
#include <string_view>

// Rewrites the spellings of the C long integer types in `value` into one
// portable name each ("unsigned long long" -> "QEXULONG64", "long int" ->
// "QEXLONG32", ...), keeping "long double" as it is, so that type comparisons
// see one spelling per type. Whole words only: "longer" is left alone.
//
// Follows the attribute-rewrite contract of changeAttributeValues: when any
// rewriting step made a change, fills `rewritten` with the result and returns
// 1; otherwise returns 0 and leaves `rewritten` alone. A value holding neither
// "long" nor "QEXDOUBLE128" (nearly every value) is rejected by a plain
// substring search, without copying.
int NormalizeTypeNames(std::string_view value, std::string& rewritten);
