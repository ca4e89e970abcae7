#pragma once

#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/MethodRecords.h"

// The method lists that the method rules compare, read from the "Method"
// children of a "Class" element in document order. A method that lacks an
// attribute a list needs is left out and named, one line per missing
// attribute, on the error log stream, tagged with the side it belongs to.

enum class ClassSide { Reference, Checked };

// The public and protected methods of `cls` that have "Signature" and
// "Access"; other accesses are left out silently.
RecordList<MethodInfo> ComparableMethods(const QEXVBTXMLNode& cls, ClassSide side);

// The methods of `cls` whose "Type" is "PureVirtual" and that have
// "Signature" and "Access" (of any value); other types are left out silently.
RecordList<MethodInfo> PureVirtualMethods(const QEXVBTXMLNode& cls, ClassSide side);
