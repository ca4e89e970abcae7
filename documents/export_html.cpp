#include "documents/export_html.h"

#include <array>
#include <string_view>
#include <unordered_map>

#include "documents/export_text.h"

namespace zor2 {

namespace {

constexpr std::string_view kHead = R"(<!DOCTYPE html>
<html lang="en">
<head>
<meta charset="utf-8">
<meta http-equiv="Content-Security-Policy" content="default-src 'none'; style-src 'unsafe-inline'; script-src 'unsafe-inline'">
<meta name="viewport" content="width=device-width, initial-scale=1">
)";

constexpr std::string_view kStyle = R"(<style>
:root { color-scheme: light; --line: #d0d4da; --muted: #5b6470; --bad: #b42318; --good: #1a7f37; }
* { box-sizing: border-box; }
body { margin: 0 auto; max-width: 72rem; padding: 1rem 1.5rem 3rem; color: #1f2328;
  font: 15px/1.45 system-ui, -apple-system, "Segoe UI", "DejaVu Sans", sans-serif;
  overflow-wrap: anywhere; }
h1 { font-size: 1.5rem; margin: 0.5rem 0; }
h2 { font-size: 1.3rem; margin: 2rem 0 0.5rem; border-bottom: 2px solid var(--line); }
h3 { font-size: 1.1rem; margin: 1.25rem 0 0.5rem; }
h4 { font-size: 1rem; margin: 1rem 0 0.4rem; }
code, .value { font-family: "DejaVu Sans Mono", Menlo, Consolas, monospace; font-size: 0.9em; }
.verdict { font-size: 1.2rem; font-weight: 700; padding: 0.6rem 0.9rem; border-radius: 6px;
  border: 2px solid; margin: 0.5rem 0; }
.verdict.failed, .verdict.error { color: var(--bad); background: #fef3f2; }
.verdict.passed { color: var(--good); background: #ecfdf3; }
.notes li { font-weight: 600; color: var(--bad); }
.muted, .group { color: var(--muted); font-weight: normal; }
.overview { display: flex; flex-wrap: wrap; gap: 1rem 2.5rem; align-items: flex-start; }
table { border-collapse: collapse; }
th, td { text-align: left; padding: 0.2rem 0.6rem; border-bottom: 1px solid var(--line);
  vertical-align: top; }
td.n { text-align: right; font-variant-numeric: tabular-nums; }
tr.zero td { color: #9aa1ab; }
.filters { position: sticky; top: 0; z-index: 1; background: #f6f8fa; border: 1px solid var(--line);
  border-radius: 6px; padding: 0.5rem 0.75rem; margin: 1.5rem 0 0.5rem; display: flex;
  flex-wrap: wrap; gap: 0.5rem 1.5rem; align-items: center; }
.filters fieldset { border: 0; margin: 0; padding: 0; display: flex; flex-wrap: wrap;
  gap: 0.2rem 0.8rem; align-items: center; }
.filters legend { float: left; font-weight: 600; margin-right: 0.5rem; }
.filters label { white-space: nowrap; }
.filters input[type=search] { width: 16rem; }
.filters button { font: inherit; font-size: 0.85em; }
.shown { color: var(--muted); margin: 0.25rem 0; }
.finding { border: 1px solid var(--line); border-left: 5px solid var(--bad); border-radius: 4px;
  padding: 0.5rem 0.75rem; margin: 0.5rem 0; }
.finding.accepted { border-left-color: #8c959f; background: #f6f8fa; }
.finding .head { display: flex; flex-wrap: wrap; gap: 0.3rem 0.6rem; align-items: baseline; }
.finding .code { font-weight: 700; font-family: "DejaVu Sans Mono", Menlo, Consolas, monospace; }
.finding .fullname { font-weight: 600; }
.state { font-size: 0.8rem; padding: 0 0.45rem; border-radius: 999px; border: 1px solid; }
.state.new { color: var(--bad); }
.state.accepted { color: var(--muted); }
.where { margin: 0.25rem 0; }
.values { margin: 0.35rem 0; width: 100%; table-layout: fixed; }
.values th { width: 50%; font-size: 0.8rem; color: var(--muted); font-weight: 600; }
.value { white-space: pre-wrap; overflow-wrap: anywhere; }
.reason { margin: 0.35rem 0; }
.help { margin: 0.35rem 0 0; color: var(--muted); font-size: 0.85rem; white-space: pre-wrap;
  tab-size: 4; }
[hidden] { display: none !important; }
@media print {
  body { max-width: none; padding: 0; font-size: 10pt; color: #000; }
  .filters { display: none !important; }
  .shown:not(.filtered) { display: none; }
  .verdict { background: none !important; }
  .finding { break-inside: avoid; background: none !important; }
  h2, h3, h4 { break-after: avoid; }
}
</style>
</head>
)";

constexpr std::string_view kScript = R"(<script>
(function () {
  'use strict';
  var form = document.getElementById('filters');
  var shown = document.getElementById('shown');
  var findings = Array.prototype.slice.call(document.querySelectorAll('article.finding'));
  var sections = Array.prototype.slice.call(
      document.querySelectorAll('section.class, section.file, section.framework'));
  function heading(section, selector) {
    var element = section && section.querySelector(selector);
    return element ? element.textContent : '';
  }
  // What the search looks in: the places and the finding, but not the help text.
  findings.forEach(function (finding) {
    var parts = [heading(finding.closest('section.framework'), 'h2'),
                 heading(finding.closest('section.file'), 'h3'),
                 heading(finding.closest('section.class'), 'h4')];
    Array.prototype.forEach.call(finding.children, function (child) {
      if (!child.classList.contains('help')) parts.push(child.textContent);
    });
    finding.searchText = parts.join(' ').toLowerCase();
  });
  function apply() {
    var codes = {};
    form.querySelectorAll('input[name=code]').forEach(function (box) {
      codes[box.value] = box.checked;
    });
    var state = form.querySelector('input[name=state]:checked').value;
    var words = form.querySelector('input[name=search]').value.toLowerCase().split(/\s+/)
        .filter(function (word) { return word !== ''; });
    var count = 0;
    findings.forEach(function (finding) {
      var show = codes[finding.dataset.code] !== false &&
          (state === 'all' || finding.dataset.state === state) &&
          words.every(function (word) { return finding.searchText.indexOf(word) >= 0; });
      finding.hidden = !show;
      if (show) count++;
    });
    sections.forEach(function (section) {
      section.hidden = !section.querySelector('article.finding:not([hidden])');
    });
    shown.textContent = count + ' of ' + findings.length + ' findings shown';
    shown.classList.toggle('filtered', count !== findings.length);
  }
  form.addEventListener('input', apply);
  form.addEventListener('change', apply);
  form.addEventListener('submit', function (event) { event.preventDefault(); });
  form.querySelectorAll('button[data-codes]').forEach(function (button) {
    button.addEventListener('click', function () {
      var on = button.dataset.codes === 'all';
      form.querySelectorAll('input[name=code]').forEach(function (box) { box.checked = on; });
      apply();
    });
  });
  form.hidden = false;
  shown.hidden = false;
  apply();
})();
</script>
)";

class Page {
 public:
  explicit Page(std::string* out) : out_(out) {}
  Page& operator<<(std::string_view markup) {
    out_->append(markup);
    return *this;
  }
  // Escaped text.
  Page& Text(std::string_view text) {
    AppendHtmlEscaped(text, out_);
    return *this;
  }
  Page& Number(int n) {
    out_->append(std::to_string(n));
    return *this;
  }

 private:
  std::string* out_;
};

// The help texts as plain text, escaped for the page, in the table's order:
// made once, since every finding shows the text of its type.
const std::array<std::string, kMessageTypes.size()>& EscapedHelpTexts() {
  static const auto texts = [] {
    std::array<std::string, kMessageTypes.size()> help;
    for (size_t i = 0; i < help.size(); ++i) {
      AppendHtmlEscaped(HelpAsText(kMessageTypes[i].help), &help[i]);
    }
    return help;
  }();
  return texts;
}

// A value, and how many more there are that it leaves out.
void WriteValueCell(Page& page, const std::string& value, int more = 0) {
  page << "<td>";
  if (value.empty()) {
    page << "<em class=\"muted\">none</em>";
  } else {
    page << "<code class=\"value\">";
    page.Text(value);
    page << "</code>";
  }
  if (more > 0) {
    page << "<br><em class=\"muted\">and ";
    page.Number(more) << " more</em>";
  }
  page << "</td>";
}

void WriteFinding(Page& page, const Finding& finding, size_t index) {
  const MessageType& type = MessageTypeOf(finding.code);
  const std::string_view state = finding.accepted ? "accepted" : "new";
  page << "<article class=\"finding " << state << "\" id=\"finding-" << std::to_string(index + 1)
       << "\" data-code=\"";
  page.Text(type.id) << "\" data-state=\"" << state
                     << "\">\n<div class=\"head\"><span class=\"code\">";
  page.Text(type.id) << "</span> <span class=\"fullname\">";
  page.Text(type.full_name) << "</span> <span class=\"state " << state << "\">" << state
                            << "</span></div>\n";
  const bool in_method = !finding.method.empty() || !finding.signature.empty();
  if (in_method || !finding.argument.empty() || finding.line > 0) {
    page << "<div class=\"where\">";
    if (in_method) {
      page << "Method <code>";
      page.Text(finding.signature.empty() ? finding.method : finding.signature) << "</code>";
    }
    if (!finding.argument.empty()) {
      page << " argument <code>";
      page.Text(finding.argument) << "</code>";
    }
    if (finding.line > 0) {
      page << (in_method || !finding.argument.empty() ? " at <code class=\"line\">"
                                                      : "At <code class=\"line\">");
      page.Text(finding.file) << ":";
      page.Number(finding.line) << "</code>";
    }
    page << "</div>\n";
  }
  if (!finding.reference_value.empty() || !finding.checked_value.empty()) {
    page << "<table class=\"values\"><tr><th>Reference</th><th>Checked</th></tr><tr>";
    WriteValueCell(page, finding.reference_value);
    WriteValueCell(page, finding.checked_value, finding.more_replacements);
    page << "</tr></table>\n";
  }
  if (finding.accepted) {
    page << "<p class=\"reason\">Accepted by the baseline";
    if (!finding.reason.empty()) {
      page << ": ";
      page.Text(finding.reason);
    }
    page << "</p>\n";
  }
  page << "<p class=\"help\">" << EscapedHelpTexts()[static_cast<size_t>(finding.code)]
       << "</p>\n</article>\n";
}

// The findings of one file: those on the file itself first, then one section
// per class in the order of its first finding.
void WriteFile(Page& page, const FileFindings& file, const Finding* first) {
  page << "<section class=\"file\">\n<h3><span class=\"group\">";
  page.Text(file.group) << "</span> ";
  page.Text(file.file) << "</h3>\n";
  std::vector<std::string_view> classes;
  std::unordered_map<std::string_view, std::vector<const Finding*>> by_class;
  for (const Finding* finding : file.findings) {
    if (finding->class_name.empty()) {
      WriteFinding(page, *finding, static_cast<size_t>(finding - first));
      continue;
    }
    auto [it, added] = by_class.try_emplace(finding->class_name);
    if (added) classes.push_back(finding->class_name);
    it->second.push_back(finding);
  }
  for (std::string_view class_name : classes) {
    page << "<section class=\"class\">\n<h4><span class=\"muted\">Class</span> ";
    page.Text(class_name) << "</h4>\n";
    for (const Finding* finding : by_class[class_name]) {
      WriteFinding(page, *finding, static_cast<size_t>(finding - first));
    }
    page << "</section>\n";
  }
  page << "</section>\n";
}

void WriteRunTable(Page& page, const RunDescription& run) {
  page << "<table class=\"run\">\n";
  const std::pair<std::string_view, const std::string*> rows[] = {
      {"Reference", &run.reference}, {"Checked", &run.checked}, {"Report", &run.report}};
  for (const auto& [label, value] : rows) {
    page << "<tr><th>" << label << "</th><td><code>";
    page.Text(*value) << "</code></td></tr>\n";
  }
  page << "<tr><th>Options</th><td>";
  for (const std::string& option : run.options) {
    page << "<code>";
    page.Text(option) << "</code> ";
  }
  page << "</td></tr>\n<tr><th>zor2check</th><td>";
  page.Text(run.tool_version) << "</td></tr>\n</table>\n";
}

void WriteCounts(Page& page, const RunSummary& summary, const std::vector<int>& accepted) {
  page << "<table class=\"counts\">\n<thead><tr><th>Code</th><th>Full name</th>"
          "<th>Findings</th><th>Accepted</th></tr></thead>\n<tbody>\n";
  for (const MessageType& type : kMessageTypes) {
    const size_t i = static_cast<size_t>(type.code);
    page << "<tr" << (summary.counts_by_code[i] == 0 ? " class=\"zero\"" : "") << "><td><code>";
    page.Text(type.id) << "</code></td><td>";
    page.Text(type.full_name) << "</td><td class=\"n\">";
    page.Number(summary.counts_by_code[i]) << "</td><td class=\"n\">";
    page.Number(accepted[i]) << "</td></tr>\n";
  }
  page << "</tbody>\n<tfoot><tr><th></th><th>Total</th><td class=\"n\">";
  page.Number(TotalFindings(summary)) << "</td><td class=\"n\">";
  page.Number(summary.accepted) << "</td></tr></tfoot>\n</table>\n";
}

// The filters, hidden until the script shows them: without a script they
// could not work.
void WriteFilters(Page& page, const std::vector<Finding>& findings) {
  std::vector<int> present(kMessageTypes.size(), 0);
  for (const Finding& finding : findings) ++present[static_cast<size_t>(finding.code)];
  page << "<form id=\"filters\" class=\"filters\" hidden>\n<fieldset><legend>Codes</legend>\n";
  for (const MessageType& type : kMessageTypes) {
    const int count = present[static_cast<size_t>(type.code)];
    if (count == 0) continue;
    page << "<label title=\"";
    page.Text(type.full_name) << "\"><input type=\"checkbox\" name=\"code\" value=\"";
    page.Text(type.id) << "\" checked> ";
    page.Text(type.id) << " <span class=\"muted\">(";
    page.Number(count) << ")</span></label>\n";
  }
  page << "<button type=\"button\" data-codes=\"all\">all</button>"
          "<button type=\"button\" data-codes=\"none\">none</button>\n</fieldset>\n"
          "<fieldset><legend>Show</legend>\n"
          "<label><input type=\"radio\" name=\"state\" value=\"all\" checked> all</label>\n"
          "<label><input type=\"radio\" name=\"state\" value=\"new\"> new</label>\n"
          "<label><input type=\"radio\" name=\"state\" value=\"accepted\"> accepted</label>\n"
          "</fieldset>\n"
          "<label>Search <input type=\"search\" name=\"search\" "
          "placeholder=\"names, signatures, values\"></label>\n</form>\n"
          "<p id=\"shown\" class=\"shown\" hidden></p>\n";
}

}  // namespace

std::string ExportHtml(const RunDescription& run, const RunSummary& summary,
                       const std::vector<Finding>& findings) {
  std::string out;
  out.reserve(16384 + findings.size() * 1536);
  Page page(&out);
  const std::string verdict = VerdictLine(summary);
  page << kHead << "<title>zor2check: ";
  page.Text(verdict) << "</title>\n" << kStyle << "<body>\n<header>\n<h1>zor2check report</h1>\n";
  page << "<p id=\"verdict\" class=\"verdict " << VerdictName(VerdictOf(summary)) << "\">";
  page.Text(verdict) << "</p>\n<p class=\"scope\">";
  page.Text(ScopeLine(summary)) << "</p>\n";
  const std::vector<std::string> notes = SummaryNotes(summary);
  if (!notes.empty()) {
    page << "<ul class=\"notes\">\n";
    for (const std::string& note : notes) {
      page << "<li>";
      page.Text(note) << "</li>\n";
    }
    page << "</ul>\n";
  }
  std::vector<int> accepted(kMessageTypes.size(), 0);
  for (const Finding& finding : findings) {
    if (finding.accepted) ++accepted[static_cast<size_t>(finding.code)];
  }
  page << "<div class=\"overview\">\n";
  WriteCounts(page, summary, accepted);
  WriteRunTable(page, run);
  page << "</div>\n</header>\n";
  if (!findings.empty()) WriteFilters(page, findings);
  page << "<main>\n";
  if (findings.empty()) page << "<p>No finding.</p>\n";
  for (const FrameworkFindings& framework : GroupByFrameworkAndFile(findings)) {
    page << "<section class=\"framework\">\n<h2><span class=\"muted\">Framework</span> ";
    page.Text(framework.framework) << "</h2>\n";
    for (const FileFindings& file : framework.files) WriteFile(page, file, findings.data());
  }
  page << "</main>\n";
  if (!findings.empty()) page << kScript;
  page << "</body>\n</html>\n";
  return out;
}

}  // namespace zor2
