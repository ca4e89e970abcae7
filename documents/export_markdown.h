#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "documents/findings.h"

namespace zor2 {

// The most characters a pull-request comment holds on the most used hosting
// service; the Markdown export stays at or under it unless asked not to.
inline constexpr size_t kMarkdownCap = 65536;

// The Markdown export, fit for a pull-request comment or a CI job summary:
// the verdict, a table of counts by code in the table's order, then the new
// findings and then the accepted ones, each grouped by framework and file,
// reference and checked values side by side. Unless `run.markdown_full` is
// set, it holds at most kMarkdownCap bytes (so as many characters at most):
// the findings that do not fit are counted in a last line that names the
// exports, or the report, that hold them. Rendered as hosting services render
// it (GitHub Flavored Markdown with autolinks), no value from the documents
// becomes markup or a link, or leaves its table cell.
std::string ExportMarkdown(const RunDescription& run, const RunSummary& summary,
                           const std::vector<Finding>& findings);

// `text` as Markdown text that shows exactly these characters, also inside a
// table cell: markup characters backslash-escaped, what would start an
// autolink broken up, line ends (LF, CR, CRLF) as "<br>".
std::string MarkdownText(std::string_view text);

// `text` as code spans that show exactly these characters in a table cell
// (where a "|" is escaped): one span per line (LF, CR and CRLF end one),
// joined by "<br>"; empty for an empty text. A text of blanks only, which a
// span would show as nothing, is described: "*blank: 3 spaces*".
std::string MarkdownCode(std::string_view text);

}  // namespace zor2
