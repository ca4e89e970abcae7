#pragma once

#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/ReportMirror.h"

// Applies the method rules to a pair of "Class" elements: loss of automation
// (CINMA), then, for every public or protected reference method that is not
// deprecated long enough before CurrentLevel, a "Method" element under
// `report` with its findings: deleted or modified method (MHBDM), and for a
// method still there, in automation classes changed order (MOHBC, once per
// class) and property modifier (PMHC), then new "@nodoc" (INDM), returned type
// (MRTHC), argument default values (ADVHC, under an "Arg" element) and
// automation return value (ARVHC, once per method). A walk without a report
// mirrors and records nothing, but still writes the log lines. Returns 1
// without doing anything when either class is null, else 0.
int CompareMethods(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                   ReportMirror& report);
