#pragma once

#include <vector>

#include "platform/xml/QEXVBTXMLNode.h"

// Records of the "Method" and "Arg" elements that the method rules compare.
// Every string points into the document the record was read from (null for an
// absent attribute); records copy nothing, so a record must not outlive its
// document.

// An ordered list of records. Records are read once per class pair and kept
// by value in the list, which owns them.
template <typename Record>
using RecordList = std::vector<Record>;

// One "Arg" element.
struct ArgInfo {
  const QEXVBTXMLNode* element = nullptr;
  const char* type = nullptr;    // "Type"
  const char* name = nullptr;    // "Name"
  const char* value = nullptr;   // "Value": the default value
  const char* retval = nullptr;  // "Retval": only its presence counts
};

// One "Method" element.
struct MethodInfo {
  const QEXVBTXMLNode* element = nullptr;
  const char* name = nullptr;          // "Name"
  const char* access = nullptr;        // "Access"
  const char* returnedType = nullptr;  // "ReturnedType"
  const char* signature = nullptr;     // "Signature"
  const char* type = nullptr;          // "Type": the kind, such as "PureVirtual"
  // First character of "Property" ('\0' for an empty value), 'N' without it.
  char property = 'N';
  RecordList<ArgInfo> args;  // one per "Arg" child, in document order
  int nodoc = 0;             // 1 when "@nodoc" is present
  int deprecated = 0;        // release of "Deprecated", 0 when not deprecated
};

// Reads one "Arg" element (not null).
ArgInfo BuildArgInfo(const QEXVBTXMLNode& arg);
// Reads one "Method" element (not null) with its "Arg" children.
MethodInfo BuildMethodInfo(const QEXVBTXMLNode& method);
// The two halves of BuildMethodInfo, for callers that pick methods by their
// attributes first: the record of the element's attributes, with no
// arguments, and then the arguments, read from the record's element.
MethodInfo ReadMethodAttributes(const QEXVBTXMLNode& method);
void ReadArguments(MethodInfo& method);

// The two argument types are both absent, or both present and equal.
bool SameArgType(const ArgInfo& a, const ArgInfo& b);
// The argument is marked as the automation return value.
bool HasRetval(const ArgInfo& a);
// The two default values are both absent, or both present and equal.
bool SameDefaultValue(const ArgInfo& a, const ArgInfo& b);
// The two returned types are both absent, or both present and equal.
bool SameReturnedType(const MethodInfo& m, const MethodInfo& n);
// The method identity: both names and both accesses present and equal, and
// the same number of arguments with the same types, position by position.
// A method without a name or an access is the same as no method at all.
bool SameMethod(const MethodInfo& m, const MethodInfo& n);
