#pragma once

#include "documents/run_summary.h"
#include "rules/finding.h"

namespace zor2 {

// The number of findings of every code together.
int TotalFindings(const RunSummary& summary);

}  // namespace zor2
