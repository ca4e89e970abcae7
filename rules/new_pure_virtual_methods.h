#pragma once

#include <vector>

#include "platform/tools/log.h"
#include "rules/method_records.h"
#include "rules/report_mirror.h"

namespace zor2 {

// Reports, under `report`, a "Method" element with an NPVM finding for every
// pure virtual method of the checked class that the reference class does not
// declare as pure virtual with the same identity (name, access, argument
// types). Methods that lack "Signature", "Access" or "Type" are left out and
// named on the warning log. `reference_methods` and `checked_methods` are the
// classes' methods (ReadClassMethods).
void CheckNewPureVirtualMethods(const std::vector<MethodRecord>& reference_methods,
                                const std::vector<MethodRecord>& checked_methods,
                                ReportMirror& report, Log& log);

}  // namespace zor2
