#pragma once

#include <optional>
#include <string>
#include <vector>

#include "documents/run_summary.h"
#include "rules/finding.h"

namespace zor2 {

// The formats "-export" writes, told by the path's extension.
enum class ExportFormat { kJson, kSarif, kMarkdown, kHtml };

// The format of an export path, or nothing for an extension of no format.
std::optional<ExportFormat> ExportFormatOf(const std::string& path);

// The text of the export in `format` of a run's findings.
std::string ExportText(ExportFormat format, const RunDescription& run, const RunSummary& summary,
                       const std::vector<Finding>& findings);

}  // namespace zor2
