// Writes the four exports of sample runs into a directory, for the tests that
// validate and render them: "example", the findings of the examples/
// workspace with two of them accepted; "hostile", findings whose names and
// values hold markup, quotes, line breaks, control characters and bytes that
// are not UTF-8; "empty"; "links", names and values that would become links,
// and a failed run; "many" and "many-full", more findings than a comment
// holds, capped and not.
#include <cstdio>
#include <filesystem>
#include <string>
#include <vector>

#include "documents/export_html.h"
#include "documents/export_json.h"
#include "documents/export_markdown.h"
#include "documents/export_sarif.h"
#include "documents/findings.h"
#include "platform/tools/file_output.h"

namespace {

using zor2::Finding;
using zor2::MessageCode;

struct Run {
  zor2::RunDescription description;
  zor2::RunSummary summary;
  std::vector<Finding> findings;
};

// Fills the counts that follow from the findings.
void Count(Run& run, int files, int frameworks) {
  for (const Finding& finding : run.findings) {
    ++run.summary.counts_by_code[static_cast<size_t>(finding.code)];
    if (finding.accepted) ++run.summary.accepted;
  }
  run.summary.files = files;
  run.summary.frameworks = frameworks;
  run.summary.failed = run.summary.accepted < static_cast<int>(run.findings.size());
}

Run ExampleRun() {
  Run run;
  run.description = {"example",
                     "examples/reference",
                     "examples/checked",
                     "build/examples-report.xml",
                     {"-L", "-level", "M4R20"},
                     {},
                     false,
                     {}};
  const std::string doc = "DocumentModel";
  const std::string geo = "Geometry";
  run.findings = {
      {MessageCode::kUHC, doc, "Public", "DocDocument.h", "", "", "", "", "U3", "U1", false, "",
       nullptr, ""},
      {MessageCode::kCINMA, doc, "Public", "DocDocument.h", "DocDocument", "", "", "", "Y", "N",
       false, "", nullptr, ""},
      {MessageCode::kMHBDM, doc, "Public", "DocDocument.h", "DocDocument", "Save",
       "HRESULT Save(const char* iPath)", "", "HRESULT Save(const char* iPath)",
       "HRESULT Save(const String& iPath)", true,
       "Save now takes a String; every caller was moved in M4R19.", nullptr, ""},
      {MessageCode::kPMHC, doc, "Public", "DocProperties.h", "DocProperties", "Title",
       "HRESULT Title(String& oTitle) const", "", "P", "R", false, "", nullptr, ""},
      {MessageCode::kINDM, doc, "Public", "DocProperties.h", "DocProperties", "Author",
       "HRESULT Author(String& oAuthor) const", "", "", "", false, "", nullptr, ""},
      {MessageCode::kARVHC, doc, "Public", "DocProperties.h", "DocProperties", "PageCount",
       "HRESULT PageCount(long& oCount) const", "", "oCount", "", false, "", nullptr, ""},
      {MessageCode::kCHBD, doc, "Public", "DocHistory.h", "DocHistory", "", "", "", "", "", false,
       "", nullptr, ""},
      {MessageCode::kMOHBC, geo, "Public", "GeoPoint.h", "GeoPoint", "GetX", "double GetX() const",
       "", "1", "2", false, "", nullptr, ""},
      {MessageCode::kADVHC, geo, "Public", "GeoPoint.h", "GeoPoint", "SetCoords",
       "void SetCoords(double iX, double iY)", "Arg_2", "", "0.0", false, "", nullptr, ""},
      {MessageCode::kMRTHC, geo, "Public", "GeoPoint.h", "GeoPoint", "Distance",
       "double Distance(const GeoPoint& iOther) const", "", "double", "float", false, "", nullptr,
       ""},
      {MessageCode::kNPVM, geo, "Public", "GeoCurve.h", "GeoCurve", "Evaluate",
       "virtual int Evaluate(double iParam, GeoPoint& oPoint) const = 0", "", "", "", false, "",
       nullptr, ""},
      {MessageCode::kFHBD, geo, "Public", "GeoLegacy.h", "", "", "", "", "", "", true,
       "Announced for removal in the M4R18 release notes.", nullptr, ""},
      {MessageCode::kLHC, geo, "Protected", "GeoMesh.h", "", "", "", "", "L1", "L2", false, "",
       nullptr, ""},
  };
  run.summary.pairs_compared = 2;
  Count(run, 7, 2);
  return run;
}

Run HostileRun() {
  Run run;
  run.description = {"0.0-<b>dev</b>",
                     "ref dir/<i>a</i>|b",
                     "chk`dir`",
                     "out \"report\".xml",
                     {"-level", "M4R20 | rm -rf"},
                     {},
                     false,
                     {}};
  const std::string fw = "<b>Bold</b> & \"Co\"";
  run.findings = {
      {MessageCode::kMRTHC, fw, "Public", "a|b <c>.h", "K`lass`", "Get",
       "std::map<int, T*> Get(const char* s = \"</script>\") const", "",
       "<script>alert('ref')</script>", "**bold** _it_ [link](javascript:alert(1)) @team $x$ |x|",
       false, "", nullptr, ""},
      {MessageCode::kMHBDM, fw, "Public", "a|b <c>.h", "K`lass`", "Run", "void Run(int ``a``)", "",
       "void Run(int ``a``)", "void Run(long a)\nvoid Run(short a)", true,
       "Accepted <em>on purpose</em> | see #12 & @lead", nullptr, ""},
      {MessageCode::kADVHC,
       "Fr\xC3\xA9"
       "d\xC3\xA9"
       "ric \xFF\xFE",
       "Protected",
       "Gr\xC3\xB6\xC3\x9F"
       "e.h",
       "C", "Set", "void Set(int a = 1)", "Arg_1", "1", "\x01\t\"\\\r\n'", false, "", nullptr, ""},
  };
  run.summary.pairs_compared = 3;
  run.summary.pairs_skipped = 1;
  run.summary.missing_documents = {zor2::Absence("Gone <1>.xml"), zor2::Absence("Old|2.xml")};
  run.summary.stale_baseline_entries = 2;
  Count(run, 2, 2);
  return run;
}

// A finding at a place, with its values.
Finding At(MessageCode code, std::string framework, std::string file, std::string class_name,
           std::string signature, std::string reference, std::string checked) {
  Finding finding;
  finding.code = code;
  finding.framework = std::move(framework);
  finding.group = "Public";
  finding.file = std::move(file);
  finding.class_name = std::move(class_name);
  finding.signature = std::move(signature);
  finding.reference_value = std::move(reference);
  finding.checked_value = std::move(checked);
  return finding;
}

// Names and values that hosting services would turn into links (URLs, "www."
// names, e-mail addresses), a lone carriage return before Markdown, blank
// values, a name too long to fit a line, a declaration's line and a capped
// list of likely replacements; the run failed.
Run LinksRun() {
  Run run;
  run.description = {"example", "https://evil.example/ref", "chk", "out.xml", {}, {}, false, {}};
  Finding automation =
      At(MessageCode::kCINMA, "https://evil.example/fw", "www.evil.com/a.h", "user@host.com", "",
         "https://ref.example", "a\r[x](http://c.example) www.d.com e@f.com");
  automation.accepted = true;
  automation.reason = "mail user@host.com or see https://x.example and www.z.com";
  Finding blank = At(MessageCode::kADVHC, "https://evil.example/fw", "www.evil.com/a.h",
                     "mailto:me@x.com", "void Set(int a =    )", "   ", "\t");
  blank.argument = "Arg_1";
  Finding moved = At(MessageCode::kMRTHC, "Geometry", "geo/Point.h", "GeoPoint",
                     "double Distance() const", "double", "float");
  moved.line = 42;
  Finding deleted = At(MessageCode::kMHBDM, "Geometry", "geo/Point.h", "GeoPoint",
                       "void Move(int dx)", "void Move(int dx)", "void Move(long dx)");
  deleted.more_replacements = 5;
  deleted.line = 7;
  run.findings = {
      automation, blank, moved, deleted,
      At(MessageCode::kFHBD, "Geometry", std::string(3000, 'W') + ".h", "", "", "", "")};
  run.summary.pairs_compared = 1;
  run.summary.files_checked = 3;
  run.summary.failures = {{"https://evil.example/in user@host.com", "No such file or directory"}};
  run.summary.missing_frameworks = {zor2::Absence("www.fw.com")};
  run.summary.missing_frameworks[0].accepted = true;
  run.summary.missing_frameworks[0].reason = "see user@host.com";
  Count(run, 3, 2);
  return run;
}

// More findings than a pull-request comment holds, new and accepted ones
// interleaved; all of them with `full`.
Run ManyRun(bool full) {
  Run run;
  run.description = {"example", "ref", "chk", "out.xml", {}, {"many.json", "many.md"}, full, {}};
  for (int i = 0; i < 2500; ++i) {
    const std::string n = std::to_string(i);
    // Appended piece by piece: GCC 12 warns wrongly on "literal" + string here.
    std::string framework = "F";
    framework += std::to_string(i % 3);
    std::string file = "File";
    file.append(n).append(".h");
    std::string class_name = "Class";
    class_name += n;
    std::string signature = "const Value& Method";
    signature.append(n).append("(int a, int b) const");
    Finding finding =
        At(MessageCode::kMRTHC, framework, file, class_name, signature, "double", "float");
    finding.accepted = i % 5 < 2;
    run.findings.push_back(finding);
  }
  run.summary.pairs_compared = 1;
  run.summary.files_checked = 2500;
  Count(run, 2500, 3);
  return run;
}

bool WriteRun(const std::string& directory, const std::string& name, const Run& run) {
  const struct {
    const char* extension;
    std::string text;
  } exports[] = {
      {".json", zor2::ExportJson(run.description, run.summary, run.findings)},
      {".sarif", zor2::ExportSarif(run.description, run.summary, run.findings)},
      {".md", zor2::ExportMarkdown(run.description, run.summary, run.findings)},
      {".html", zor2::ExportHtml(run.description, run.summary, run.findings)},
  };
  for (const auto& e : exports) {
    const std::string path = directory + "/" + name + e.extension;
    std::string err;
    if (!zor2::WriteFileAtomically(path, e.text, nullptr, &err)) {
      std::fprintf(stderr, "export_example: %s: %s\n", path.c_str(), err.c_str());
      return false;
    }
  }
  return true;
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 2) {
    std::fprintf(stderr, "usage: export_example DIRECTORY\n");
    return 1;
  }
  const std::string directory = argv[1];
  std::error_code error;
  std::filesystem::create_directories(directory, error);
  Run empty;
  empty.description = {"example", "ref.xml", "chk.xml", "out.xml", {}, {}, false, {}};
  empty.summary.pairs_compared = 1;
  const bool written =
      WriteRun(directory, "example", ExampleRun()) &&
      WriteRun(directory, "hostile", HostileRun()) && WriteRun(directory, "empty", empty) &&
      WriteRun(directory, "links", LinksRun()) && WriteRun(directory, "many", ManyRun(false)) &&
      WriteRun(directory, "many-full", ManyRun(true));
  return written ? 0 : 2;
}
