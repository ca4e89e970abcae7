#pragma once

#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/MethodRecords.h"

// Helpers of the walks that mirror compared elements into the report. A null
// report element means that nothing is mirrored, so all of them accept null.

// Appends a new, empty element `tag` as the last child of `parent` and returns
// it (owned by `parent`); returns null and creates nothing when `parent` is
// null.
QEXVBTXMLNode* MirrorElement(QEXVBTXMLNode* parent, const char* tag);

// Sets attribute `name` of `element` to a copy of `value`; does nothing when
// `element` or `value` is null, so an absent attribute stays absent.
void MirrorAttribute(QEXVBTXMLNode* element, const char* name, const char* value);

// Appends a "Method" element carrying the name and signature of `method` under
// `reportClass` and returns it, or null when `reportClass` is null.
QEXVBTXMLNode* MirrorMethod(QEXVBTXMLNode* reportClass, const MethodInfo& method);
