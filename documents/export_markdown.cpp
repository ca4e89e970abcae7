#include "documents/export_markdown.h"

#include <algorithm>

#include "documents/export_text.h"

namespace zor2 {

namespace {

// The characters that start or end Markdown markup, mentions, math, entities
// or HTML, or that end a table cell.
constexpr std::string_view kMarkupCharacters = "\\`*_[]<>|~&$#@!{}";

// One line of a value as a code span. The fence is one backtick longer than
// the longest run of backticks inside; a blank keeps a backtick at either end
// from joining the fence (and is dropped again by the reader).
std::string CodeSpan(std::string_view line) {
  size_t longest = 0;
  size_t run = 0;
  for (char c : line) {
    run = c == '`' ? run + 1 : 0;
    longest = std::max(longest, run);
  }
  const std::string fence(longest + 1, '`');
  const bool pad = line.front() == '`' || line.back() == '`' ||
                   (line.size() > 1 && line.front() == ' ' && line.back() == ' ');
  std::string span = fence;
  if (pad) span += ' ';
  std::string valid;
  AppendValidUtf8(line, &valid);
  for (char c : valid) {
    // Inside a table a "|" ends the cell unless escaped, even in a code span.
    if (c == '|') span += '\\';
    span += c;
  }
  if (pad) span += ' ';
  return span + fence;
}

std::string ValueCell(std::string_view value, std::string_view other) {
  if (!value.empty()) return MarkdownCode(value);
  return other.empty() ? "" : "*none*";
}

std::string StatusCell(const Finding& finding) {
  if (!finding.accepted) return "new";
  if (finding.reason.empty()) return "accepted";
  return "accepted: " + MarkdownText(finding.reason);
}

std::string MethodCell(const Finding& finding) {
  std::string cell = MarkdownCode(finding.signature.empty() ? finding.method : finding.signature);
  if (!finding.argument.empty()) {
    if (!cell.empty()) cell += ", ";
    cell += MarkdownText(finding.argument);
  }
  return cell;
}

void AppendCounts(const RunSummary& summary, std::string* out) {
  out->append("| Code | Full name | Findings |\n| --- | --- | ---: |\n");
  for (const MessageType& type : kMessageTypes) {
    out->append("| `" + std::string(type.id) + "` | " + MarkdownText(type.full_name) + " | " +
                std::to_string(summary.counts_by_code[static_cast<size_t>(type.code)]) + " |\n");
  }
  out->append("| | **Total** | **" + std::to_string(TotalFindings(summary)) + "** |\n\n");
}

void AppendRun(const RunDescription& run, std::string* out) {
  out->append("| Run | |\n| --- | --- |\n");
  out->append("| Reference | " + MarkdownCode(run.reference) + " |\n");
  out->append("| Checked | " + MarkdownCode(run.checked) + " |\n");
  out->append("| Report | " + MarkdownCode(run.report) + " |\n");
  std::string options;
  for (const std::string& option : run.options) {
    if (!options.empty()) options += ' ';
    options += MarkdownCode(option);
  }
  out->append("| Options | " + options + " |\n");
  out->append("| zor2check | " + MarkdownText(run.tool_version) + " |\n\n");
}

void AppendFile(const FileFindings& file, std::string* out) {
  out->append("#### " + MarkdownText(file.group) + ": " + MarkdownText(file.file) + "\n\n");
  out->append(
      "| Code | Class | Method | Reference | Checked | Status |\n"
      "| --- | --- | --- | --- | --- | --- |\n");
  for (const Finding* finding : file.findings) {
    out->append("| `" + std::string(MessageTypeOf(finding->code).id) + "` | " +
                MarkdownCode(finding->class_name) + " | " + MethodCell(*finding) + " | " +
                ValueCell(finding->reference_value, finding->checked_value) + " | " +
                ValueCell(finding->checked_value, finding->reference_value) +
                (finding->more_replacements > 0
                     ? "<br>*and " + std::to_string(finding->more_replacements) + " more*"
                     : "") +
                " | " + StatusCell(*finding) + " |\n");
  }
  out->append("\n");
}

}  // namespace

std::string MarkdownText(std::string_view text) {
  std::string valid;
  AppendValidUtf8(text, &valid);
  std::string escaped;
  escaped.reserve(valid.size() + valid.size() / 4);
  for (char c : valid) {
    if (c == '\n') {
      escaped += "<br>";
      continue;
    }
    if (c == '\r') continue;
    if (kMarkupCharacters.find(c) != std::string_view::npos) escaped += '\\';
    escaped += c;
  }
  return escaped;
}

std::string MarkdownCode(std::string_view text) {
  std::string code;
  size_t start = 0;
  while (start <= text.size()) {
    size_t end = text.find('\n', start);
    if (end == std::string_view::npos) end = text.size();
    std::string_view line = text.substr(start, end - start);
    if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
    if (!line.empty()) {
      if (!code.empty()) code += "<br>";
      code += CodeSpan(line);
    }
    start = end + 1;
  }
  return code;
}

std::string ExportMarkdown(const RunDescription& run, const RunSummary& summary,
                           const std::vector<Finding>& findings) {
  std::string out;
  out.append("## zor2check: " + MarkdownText(VerdictLine(summary)) + "\n\n");
  out.append(MarkdownText(ScopeLine(summary)) + "\n\n");
  const std::vector<std::string> notes = SummaryNotes(summary);
  for (const std::string& note : notes) out.append("- **" + MarkdownText(note) + "**\n");
  if (!notes.empty()) out.append("\n");
  AppendCounts(summary, &out);
  AppendRun(run, &out);
  for (const FrameworkFindings& framework : GroupByFrameworkAndFile(findings)) {
    out.append("### Framework " + MarkdownText(framework.framework) + "\n\n");
    for (const FileFindings& file : framework.files) AppendFile(file, &out);
  }
  return out;
}

}  // namespace zor2
