#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "documents/findings.h"

// What the four exports share: text escaping, the verdict and summary
// sentences, and the grouping of findings by framework and file.

namespace zor2 {

// Appends `text` with every byte sequence that is not UTF-8 (a stray byte, an
// overlong form, a surrogate, a code point beyond U+10FFFF) replaced by U+FFFD,
// since the readers of every export reject or garble such bytes.
void AppendValidUtf8(std::string_view text, std::string* out);

// Appends `text` as a JSON string, quotes included.
void AppendJsonString(std::string_view text, std::string* out);

// Appends `text` escaped for HTML text and quoted attribute values.
void AppendHtmlEscaped(std::string_view text, std::string* out);

// A message type's help text, which is HTML, as plain text: "<BR>" and the
// "<PRE>" block become line breaks, the rest stays as written.
std::string HelpAsText(std::string_view help);

// "1 finding", "2 findings".
std::string CountOf(int count, std::string_view noun);

// The verdict in one line: "FAILED: 3 new findings (1 accepted by the
// baseline)", "PASSED: no finding", "ERROR: the check is incomplete: an input
// or output failed", ...
std::string VerdictLine(const RunSummary& summary);

// Where the findings sit and what was compared, in one sentence.
std::string ScopeLine(const RunSummary& summary);

// The sentences that need a reader's attention beyond the findings: what
// failed, pairs skipped for an error, nothing checked, reference documents and
// frameworks without counterpart, baseline entries that matched nothing.
// Empty when there are none.
std::vector<std::string> SummaryNotes(const RunSummary& summary);

// Where a finding sits below its file, for a reader: "class GeoPoint, double
// GetX() const, Arg_2". Empty for a finding on the file itself.
std::string PlaceInFile(const Finding& finding);

struct FileFindings {
  std::string group;
  std::string file;
  std::vector<const Finding*> findings;  // in the order given
};

struct FrameworkFindings {
  std::string framework;
  std::vector<FileFindings> files;
};

// The findings grouped by framework, then by group and file, each in the order
// of its first finding; the findings keep their order inside a file.
std::vector<FrameworkFindings> GroupByFrameworkAndFile(const std::vector<Finding>& findings);
std::vector<FrameworkFindings> GroupByFrameworkAndFile(const std::vector<const Finding*>& findings);

}  // namespace zor2
