#pragma once

#include "platform/tools/log.h"
#include "platform/xml/document.h"
#include "rules/report_mirror.h"

namespace zor2 {

// Reports, under `report`, a "Method" element with an NPVM finding for every
// pure virtual method of the checked class that the reference class does not
// declare as pure virtual with the same identity (name, access, argument
// types). Methods that lack "Signature", "Access" or "Type" are left out and
// named on the warning log.
void CheckNewPureVirtualMethods(const xml::Element& reference, const xml::Element& checked,
                                ReportMirror& report, Log& log);

}  // namespace zor2
