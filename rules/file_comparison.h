#pragma once

#include "platform/tools/log.h"
#include "platform/xml/document.h"
#include "rules/check_settings.h"
#include "rules/report_mirror.h"

namespace zor2 {

// Compares the files of interface group `group` ("Public" or "Protected") of a
// pair of "Framework" elements: mirrors an "Interfaces" element named `group`
// under `report` and, under it, a "File" element for every reference file
// subject to checking; reports deleted files (FHBD) and, with only flagged
// files, level (LHC) and usage (UHC) changes; compares the classes of every
// file pair.
void CompareInterfaceFiles(const xml::Element& reference, const xml::Element& checked,
                           const char* group, const CheckSettings& settings, ReportMirror& report,
                           Log& log);

}  // namespace zor2
