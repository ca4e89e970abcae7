#pragma once

#include <string>
#include <vector>

#include "documents/findings.h"
#include "documents/json_writer.h"

namespace zor2 {

// The JSON export: the tool's version, the inputs and options, the summary and
// a flat array of findings with every field; docs/export.schema.json describes
// it. Valid UTF-8 whatever bytes the values hold.
std::string ExportJson(const RunDescription& run, const RunSummary& summary,
                       const std::vector<Finding>& findings);

// The reference documents and frameworks without counterpart, as the JSON
// and SARIF exports give them: an array of objects with "kind" ("document" or
// "framework"), "name", "accepted" and "reason".
void WriteAbsences(const RunSummary& summary, JsonWriter& json);

}  // namespace zor2
