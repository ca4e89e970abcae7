#pragma once

#include "platform/tools/log.h"
#include "platform/xml/document.h"
#include "rules/check_settings.h"
#include "rules/report_mirror.h"

namespace zor2 {

// Compares the classes of a pair of "File" elements: pairs them by name,
// mirrors a "Class" element under `report` for every reference class, reports
// deleted classes (CHBD), and applies the method rules to every class pair,
// followed by the new-pure-virtual rule when `check_new_pure_virtual` is set.
void CompareClasses(const xml::Element& reference, const xml::Element& checked,
                    bool check_new_pure_virtual, const CheckSettings& settings,
                    ReportMirror& report, Log& log);

}  // namespace zor2
