#pragma once

#include <vector>

#include "platform/xml/document.h"

namespace zor2 {

// Records of the "Method" and "Arg" elements that the method rules compare.
// Every string points into the document the record was read from (null for an
// absent attribute); records copy nothing, so a record must not outlive its
// document.

// One "Arg" element.
struct ArgumentRecord {
  const char* type = nullptr;    // "Type"
  const char* name = nullptr;    // "Name"
  const char* value = nullptr;   // "Value": the default value
  const char* retval = nullptr;  // "Retval": only its presence counts
};

// One "Method" element.
struct MethodRecord {
  const xml::Element* element = nullptr;
  const char* name = nullptr;           // "Name"
  const char* access = nullptr;         // "Access"
  const char* returned_type = nullptr;  // "ReturnedType"
  const char* signature = nullptr;      // "Signature"
  const char* type = nullptr;           // "Type": the kind, such as "PureVirtual"
  // First character of "Property" ('\0' for an empty value), 'N' without it.
  char property = 'N';
  bool nodoc = false;                // "@nodoc" is present
  int deprecated = 0;                // release of "Deprecated", 0 when not deprecated
  std::vector<ArgumentRecord> args;  // one per "Arg" child, in document order
};

// Reads the attributes of a "Method" element, without its arguments: callers
// pick methods by their attributes first, then read the arguments of those
// they keep with ReadArguments.
MethodRecord ReadMethodAttributes(const xml::Element& method);
// Fills `method.args` from the "Arg" children of its element.
void ReadArguments(MethodRecord& method);
// Both steps.
MethodRecord ReadMethod(const xml::Element& method);

// The two argument types are both absent, or both present and equal.
bool SameArgType(const ArgumentRecord& a, const ArgumentRecord& b);
// The two default values are both absent, or both present and equal.
bool SameDefaultValue(const ArgumentRecord& a, const ArgumentRecord& b);
// The two returned types are both absent, or both present and equal.
bool SameReturnedType(const MethodRecord& m, const MethodRecord& n);
// The method identity: both names and both accesses present and equal, and
// the same number of arguments with the same types, position by position. A
// method without a name or an access is the same as no method at all.
bool SameMethod(const MethodRecord& m, const MethodRecord& n);

}  // namespace zor2
