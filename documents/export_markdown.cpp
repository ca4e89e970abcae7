#include "documents/export_markdown.h"

#include <algorithm>

#include "documents/export_text.h"

namespace zor2 {

namespace {

// The characters that start or end Markdown markup, mentions, math, entities
// or HTML, or that end a table cell.
constexpr std::string_view kMarkupCharacters = "\\`*_[]<>|~&$#@!{}";

// What the capped export keeps of the parts above the findings, so that the
// findings always have room: notes are cut at kNoteLimit bytes and at most
// kMaxNotes are shown, the options at kOptionsLimit bytes.
constexpr size_t kNoteLimit = 1000;
constexpr size_t kMaxNotes = 10;
constexpr size_t kOptionsLimit = 2000;

bool IsEmailCharacter(char c) {
  return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '.' ||
         c == '+' || c == '-' || c == '_';
}

bool IsBlank(char c) {
  return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

// "1 space", "2 tabs".
std::string Blanks(size_t count, std::string_view noun) {
  return std::to_string(count) + " " + std::string(noun) + (count == 1 ? "" : "s");
}

// A text of blanks only, described: "*blank: 3 spaces, 1 line break*".
std::string DescribedBlanks(std::string_view text) {
  size_t spaces = 0;
  size_t tabs = 0;
  size_t line_ends = 0;
  for (size_t i = 0; i < text.size(); ++i) {
    if (text[i] == ' ') ++spaces;
    if (text[i] == '\t') ++tabs;
    // A CRLF is one line end.
    if (text[i] == '\n' || (text[i] == '\r' && (i + 1 == text.size() || text[i + 1] != '\n'))) {
      ++line_ends;
    }
  }
  std::string parts;
  for (const auto& [count, noun] : {std::pair<size_t, std::string_view>{spaces, "space"},
                                    {tabs, "tab"},
                                    {line_ends, "line break"}}) {
    if (count == 0) continue;
    if (!parts.empty()) parts += ", ";
    parts += Blanks(count, noun);
  }
  return "*blank: " + parts + "*";
}

// One line of a value as a code span, inside which no autolink is ever made.
// The fence is one backtick longer than the longest run of backticks inside;
// a blank keeps a backtick at either end from joining the fence (and is
// dropped again by the reader).
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

// `text` cut to at most `limit` bytes at a character's start, with "..."
// after what was cut.
std::string Shortened(std::string_view text, size_t limit) {
  if (text.size() <= limit) return std::string(text);
  size_t end = limit;
  while (end > 0 && (static_cast<unsigned char>(text[end]) & 0xC0) == 0x80) --end;
  return std::string(text.substr(0, end)) + "...";
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

std::string Row(const Finding& finding, bool with_lines) {
  std::string row = "| `" + std::string(MessageTypeOf(finding.code).id) + "` | " +
                    MarkdownCode(finding.class_name) + " | " + MethodCell(finding) + " | " +
                    ValueCell(finding.reference_value, finding.checked_value) + " | " +
                    ValueCell(finding.checked_value, finding.reference_value);
  if (finding.more_replacements > 0) {
    row += "<br>*and " + std::to_string(finding.more_replacements) + " more*";
  }
  row += " | " + StatusCell(finding);
  if (with_lines) {
    row += " | ";
    if (finding.line > 0) row += MarkdownCode(finding.file + ":" + std::to_string(finding.line));
  }
  return row + " |\n";
}

void AppendCounts(const RunSummary& summary, std::string* out) {
  out->append("| Code | Full name | Findings |\n| --- | --- | ---: |\n");
  for (const MessageType& type : kMessageTypes) {
    out->append("| `" + std::string(type.id) + "` | " + MarkdownText(type.full_name) + " | " +
                std::to_string(summary.counts_by_code[static_cast<size_t>(type.code)]) + " |\n");
  }
  out->append("| | **Total** | **" + std::to_string(TotalFindings(summary)) + "** |\n\n");
}

void AppendRun(const RunDescription& run, bool capped, std::string* out) {
  out->append("| Run | |\n| --- | --- |\n");
  out->append("| Reference | " + MarkdownCode(run.reference) + " |\n");
  out->append("| Checked | " + MarkdownCode(run.checked) + " |\n");
  out->append("| Report | " + MarkdownCode(run.report) + " |\n");
  std::string options;
  for (size_t i = 0; i < run.options.size(); ++i) {
    const std::string option = MarkdownCode(run.options[i]);
    if (capped && options.size() + option.size() > kOptionsLimit) {
      options += " *and " + std::to_string(run.options.size() - i) + " more*";
      break;
    }
    if (!options.empty()) options += ' ';
    options += option;
  }
  out->append("| Options | " + options + " |\n");
  out->append("| zor2check | " + MarkdownText(run.tool_version) + " |\n\n");
}

void AppendNotes(const RunSummary& summary, bool capped, std::string* out) {
  const std::vector<std::string> notes = SummaryNotes(summary);
  for (size_t i = 0; i < notes.size(); ++i) {
    if (capped && i == kMaxNotes) {
      out->append("- **and " + std::to_string(notes.size() - i) + " more notes**\n");
      break;
    }
    const std::string note = capped ? Shortened(notes[i], kNoteLimit) : notes[i];
    out->append("- **" + MarkdownText(note) + "**\n");
  }
  if (!notes.empty()) out->append("\n");
}

// Appends the findings of one section while they fit under `room` bytes;
// returns how many did.
size_t AppendSection(std::string_view title, const std::vector<const Finding*>& findings,
                     bool with_lines, size_t room, std::string* out) {
  std::string heading = "### " + CountOf(static_cast<int>(findings.size()), title) + "\n\n";
  size_t shown = 0;
  for (const FrameworkFindings& framework : GroupByFrameworkAndFile(findings)) {
    heading += "#### Framework " + MarkdownText(framework.framework) + "\n\n";
    for (const FileFindings& file : framework.files) {
      heading += "##### " + MarkdownText(file.group) + ": " + MarkdownText(file.file) + "\n\n";
      heading += "| Code | Class | Method | Reference | Checked | Status |";
      heading += with_lines ? " Line |\n| --- | --- | --- | --- | --- | --- | --- |\n"
                            : "\n| --- | --- | --- | --- | --- | --- |\n";
      for (const Finding* finding : file.findings) {
        // The headings above a row only come with it.
        const std::string row = Row(*finding, with_lines);
        if (out->size() + heading.size() + row.size() > room) return shown;
        out->append(heading).append(row);
        heading.clear();
        ++shown;
      }
      if (heading.empty()) out->append("\n");
      heading.clear();
    }
    heading.clear();
  }
  return shown;
}

// The line that says how many findings were left out, and where they are: the
// run's other exports, else its report.
std::string LeftOutLine(const RunDescription& run, size_t left_new, size_t left_accepted) {
  std::string holders;
  std::vector<std::string> others;
  for (const std::string& path : run.exports) {
    if (!path.ends_with(".md")) others.push_back(path);
  }
  if (others.empty()) others.push_back(run.report);
  for (size_t i = 0; i < others.size(); ++i) {
    if (i > 0) holders += i + 1 == others.size() ? " and " : ", ";
    holders += MarkdownCode(others[i]);
  }
  // Paths too long to be worth the room are not named.
  if (holders.size() > 4096) holders = "the other outputs of the run";
  const int left = static_cast<int>(left_new + left_accepted);
  return "**" + CountOf(left, "more finding") + " (" + std::to_string(left_new) + " new, " +
         std::to_string(left_accepted) + " accepted) " + (left == 1 ? "is" : "are") +
         " left out to keep this page under " + std::to_string(kMarkdownCap) +
         " characters: " + holders + (others.size() == 1 ? " holds" : " hold") +
         " every finding.**\n";
}

}  // namespace

std::string MarkdownText(std::string_view text) {
  std::string valid;
  AppendValidUtf8(text, &valid);
  std::string escaped;
  escaped.reserve(valid.size() + valid.size() / 4);
  for (size_t i = 0; i < valid.size(); ++i) {
    const char c = valid[i];
    if (c == '\r' || c == '\n') {
      escaped += "<br>";
      if (c == '\r' && i + 1 < valid.size() && valid[i + 1] == '\n') ++i;
      continue;
    }
    // Autolinks: "http://" and the like start at an unescaped ":" before
    // "//", "www." at its "."; an e-mail address is found in the text
    // whatever its escapes, so an empty comment splits the text before an
    // "@" that follows what could be its local part.
    if (c == '@' && i > 0 && IsEmailCharacter(valid[i - 1])) escaped += "<!-- -->";
    const bool after_www = i >= 3 && (valid[i - 1] | 0x20) == 'w' && (valid[i - 2] | 0x20) == 'w' &&
                           (valid[i - 3] | 0x20) == 'w';
    const bool before_slashes = valid.compare(i + 1, 2, "//") == 0;
    if (kMarkupCharacters.find(c) != std::string_view::npos || (c == ':' && before_slashes) ||
        (c == '.' && after_www)) {
      escaped += '\\';
    }
    escaped += c;
  }
  return escaped;
}

std::string MarkdownCode(std::string_view text) {
  if (!text.empty() && std::all_of(text.begin(), text.end(), IsBlank)) {
    return DescribedBlanks(text);
  }
  std::string code;
  size_t start = 0;
  while (start < text.size()) {
    size_t end = text.find_first_of("\r\n", start);
    if (end == std::string_view::npos) end = text.size();
    const std::string_view line = text.substr(start, end - start);
    if (!line.empty()) {
      if (!code.empty()) code += "<br>";
      code += CodeSpan(line);
    }
    start = end + (text.substr(end, 2) == "\r\n" ? 2 : 1);
  }
  return code;
}

std::string ExportMarkdown(const RunDescription& run, const RunSummary& summary,
                           const std::vector<Finding>& findings) {
  const bool capped = !run.markdown_full;
  std::string out;
  out.append("## zor2check: " + MarkdownText(VerdictLine(summary)) + "\n\n");
  out.append(MarkdownText(ScopeLine(summary)) + "\n\n");
  AppendNotes(summary, capped, &out);
  AppendCounts(summary, &out);
  AppendRun(run, capped, &out);

  std::vector<const Finding*> fresh;
  std::vector<const Finding*> accepted;
  bool with_lines = false;
  for (const Finding& finding : findings) {
    (finding.accepted ? accepted : fresh).push_back(&finding);
    with_lines = with_lines || finding.line > 0;
  }
  // Room is kept for the last line, whatever it will count.
  const size_t tail = capped ? LeftOutLine(run, fresh.size(), accepted.size()).size() : 0;
  const size_t room = capped && kMarkdownCap > tail ? kMarkdownCap - tail : SIZE_MAX;
  size_t shown_new = 0;
  size_t shown_accepted = 0;
  if (!fresh.empty()) shown_new = AppendSection("new finding", fresh, with_lines, room, &out);
  if (!accepted.empty() && shown_new == fresh.size()) {
    shown_accepted = AppendSection("accepted finding", accepted, with_lines, room, &out);
  }
  if (shown_new < fresh.size() || shown_accepted < accepted.size()) {
    out.append(LeftOutLine(run, fresh.size() - shown_new, accepted.size() - shown_accepted));
  }
  return out;
}

}  // namespace zor2
