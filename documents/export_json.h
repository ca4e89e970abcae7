#pragma once

#include <string>
#include <vector>

#include "documents/findings.h"

namespace zor2 {

// The JSON export: the tool's version, the inputs and options, the summary and
// a flat array of findings with every field; docs/export.schema.json describes
// it. Valid UTF-8 whatever bytes the values hold.
std::string ExportJson(const RunDescription& run, const RunSummary& summary,
                       const std::vector<Finding>& findings);

}  // namespace zor2
