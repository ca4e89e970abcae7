#pragma once

#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/ReportMirror.h"

// Reports, under `report` (a walk without a report mirrors and records
// nothing), a "Method" element with an NPVM finding for every pure virtual
// method of the checked class that the reference class does not declare as
// pure virtual with the same identity (name, access, argument types). Methods
// that lack "Signature", "Access" or "Type" are left out and named on the
// error log stream. Returns 0; does nothing when either class is null.
int CheckNewPureVirtualMethods(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                               ReportMirror& report);
