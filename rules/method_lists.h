#pragma once

#include <vector>

#include "platform/tools/log.h"
#include "platform/xml/document.h"
#include "rules/method_records.h"

namespace zor2 {

// The method lists that the method rules compare. A class's "Method" children
// are read once (ReadClassMethods) and both rules pick their lists from those
// records. A method that lacks an attribute a list needs is left out and named
// on the warning log, one line per missing attribute, tagged with the side it
// belongs to.

enum class ClassSide { kReference, kChecked };

// The records of the "Method" children of `cls`, in document order: each with
// its attributes, and with its arguments when a list below may keep it.
std::vector<MethodRecord> ReadClassMethods(const xml::Element& cls);

// The public and protected methods of `methods` that have "Signature" and
// "Access"; other accesses are left out silently. The list points into
// `methods`.
std::vector<const MethodRecord*> ComparableMethods(const std::vector<MethodRecord>& methods,
                                                   ClassSide side, Log& log);

// The methods of `methods` whose "Type" is "PureVirtual" and that have
// "Signature" and "Access" (of any value); other types are left out silently.
// The list points into `methods`.
std::vector<const MethodRecord*> PureVirtualMethods(const std::vector<MethodRecord>& methods,
                                                    ClassSide side, Log& log);

}  // namespace zor2
