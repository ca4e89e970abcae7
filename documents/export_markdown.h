#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "documents/findings.h"

namespace zor2 {

// The Markdown export, fit for a pull-request comment or a CI job summary:
// the verdict, a table of counts by code in the table's order, then the
// findings grouped by framework and file, reference and checked values side
// by side.
std::string ExportMarkdown(const RunDescription& run, const RunSummary& summary,
                           const std::vector<Finding>& findings);

// `text` as Markdown text that shows exactly these characters, also inside a
// table cell: markup characters backslash-escaped, line feeds as "<br>".
std::string MarkdownText(std::string_view text);

// `text` as code spans that show exactly these characters in a table cell
// (where a "|" is escaped): one span per line, joined by "<br>"; empty for an
// empty text.
std::string MarkdownCode(std::string_view text);

}  // namespace zor2
