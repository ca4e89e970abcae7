// Writes the four exports of two runs into a directory, for the tests that
// validate and render them: "example", the findings of the examples/
// workspace with two of them accepted, and "hostile", findings whose names and
// values hold markup, quotes, line breaks, control characters and bytes that
// are not UTF-8.
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
  const bool written = WriteRun(directory, "example", ExampleRun()) &&
                       WriteRun(directory, "hostile", HostileRun()) &&
                       WriteRun(directory, "empty", empty);
  return written ? 0 : 2;
}
