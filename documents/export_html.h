#pragma once

#include <string>
#include <vector>

#include "documents/findings.h"

namespace zor2 {

// The HTML export: one self-contained page (its style and script inline, and a
// policy that forbids loading anything) with the verdict and the counts on
// top, then the findings grouped by framework, file and class, each with its
// reference and checked values and the help text of its type. Without
// JavaScript every finding is shown; with it, filters by code and by
// accepted or new findings and a text search appear. Every value is escaped.
std::string ExportHtml(const RunDescription& run, const RunSummary& summary,
                       const std::vector<Finding>& findings);

}  // namespace zor2
