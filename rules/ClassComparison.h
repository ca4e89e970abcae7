#pragma once

#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/ReportMirror.h"

// Compares the classes of a pair of "File" elements: pairs them by name,
// mirrors a "Class" element under `report` (a walk without a report mirrors
// and records nothing) for every reference class, reports deleted classes
// (CHBD), and applies the method rules to every class pair, followed by the
// new-pure-virtual rule when `checkNewPureVirtual` is non-zero. Returns 0.
int CompareClasses(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                   ReportMirror& report, int checkNewPureVirtual);
