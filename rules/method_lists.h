#pragma once

#include <vector>

#include "platform/tools/log.h"
#include "platform/xml/document.h"
#include "rules/method_records.h"

namespace zor2 {

// The method lists that the method rules compare, read from the "Method"
// children of a "Class" element in document order. A method that lacks an
// attribute a list needs is left out and named on the warning log, one line
// per missing attribute, tagged with the side it belongs to.

enum class ClassSide { kReference, kChecked };

// The public and protected methods of `cls` that have "Signature" and
// "Access"; other accesses are left out silently.
std::vector<MethodRecord> ComparableMethods(const xml::Element& cls, ClassSide side, Log& log);

// The methods of `cls` whose "Type" is "PureVirtual" and that have
// "Signature" and "Access" (of any value); other types are left out silently.
std::vector<MethodRecord> PureVirtualMethods(const xml::Element& cls, ClassSide side, Log& log);

}  // namespace zor2
