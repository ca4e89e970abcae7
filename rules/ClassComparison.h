#pragma once

#include "platform/xml/QEXVBTXMLNode.h"

// Compares the classes of a pair of "File" elements: pairs them by name,
// appends a "Class" element under `report` (may be null: then nothing is
// mirrored or recorded) for every reference class, reports deleted classes
// (CHBD), and applies the method rules to every class pair, followed by the
// new-pure-virtual rule when `checkNewPureVirtual` is non-zero. Returns 0.
int CompareClasses(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                   QEXVBTXMLNode*& report, int checkNewPureVirtual);
