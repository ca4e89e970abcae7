#pragma once

#include "platform/xml/QEXVBTXMLNode.h"

// Compares the frameworks of one document pair: pairs reference and checked
// "Framework" elements by name and, for each pair, compares the "Public" and
// then the "Protected" interface groups. Mirrors every reference framework
// under `report` and records the findings there; with a null `report` nothing
// is mirrored or recorded, but the walk and its log lines still run.
// Returns 0.
int CompareFrameworks(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                      QEXVBTXMLNode*& report);
