#pragma once

#include <vector>

#include "platform/xml/QEXVBTXMLNode.h"

// The direct children of `parent` whose tag is `tag`, in document order; none
// for a null `parent`. The elements belong to `parent`'s document.
std::vector<QEXVBTXMLNode*> ChildElements(const QEXVBTXMLNode* parent, const char* tag);
