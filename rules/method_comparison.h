#pragma once

#include <vector>

#include "platform/tools/log.h"
#include "platform/xml/document.h"
#include "rules/check_settings.h"
#include "rules/method_records.h"
#include "rules/report_mirror.h"

namespace zor2 {

// Applies the method rules to a pair of "Class" elements: loss of automation
// (CINMA), then, for every public or protected reference method that is not
// deprecated long enough before the checked level, a "Method" element under
// `report` with its findings: deleted or modified method (MHBDM), and for a
// method still there, in automation classes changed order (MOHBC, once per
// class) and property modifier (PMHC), then new "@nodoc" (INDM), returned type
// (MRTHC), argument default values (ADVHC, under an "Arg" element) and
// automation return value (ARVHC, once per method). `reference_methods` and
// `checked_methods` are the classes' methods (ReadClassMethods).
void CompareMethods(const xml::Element& reference, const xml::Element& checked,
                    const std::vector<MethodRecord>& reference_methods,
                    const std::vector<MethodRecord>& checked_methods, const CheckSettings& settings,
                    ReportMirror& report, Log& log);

}  // namespace zor2
