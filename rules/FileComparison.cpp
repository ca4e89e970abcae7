#include "rules/FileComparison.h"

#include <cstdint>
#include <cstring>
#include <string_view>

#include "documents/InterfaceDocument.h"
#include "platform/tools/ZOROFStream.h"
#include "platform/xml/QEXVBTXMLSearch.h"
#include "rules/CheckSettings.h"
#include "rules/ChildElements.h"
#include "rules/ClassComparison.h"
#include "rules/PairingIndex.h"
#include "rules/ReportMirror.h"
#include "rules/ZOR2Error.h"

namespace {

// A class deprecated at most two releases before the checked level, or later.
bool RecentlyDeprecatedClass(const QEXVBTXMLNode& cls) {
  const int release = ReleaseAfterR(cls.getAttributeValue("Deprecated"));
  return release != 0 && int64_t{release} + 2 >= int64_t{CurrentLevel};
}

// Only automation files are checked, and with OnlyFlaggedFiles only those of
// level "L1".
bool PassesFileFilter(const QEXVBTXMLNode& file) {
  if (OnlyFlaggedFiles && !FirstWordIs(file.getAttributeValue("@ZOR2Level"), "L1")) return false;
  return FirstWordIs(file.getAttributeValue("Aut"), "Y");
}

void MirrorFile(ReportMirror& reportFile, const QEXVBTXMLNode& file) {
  reportFile.CopyAttribute("Name", file.getAttributeValue("Name"));
  if (OnlyFlaggedFiles) {
    reportFile.CopyAttribute("@ZOR2Level", file.getAttributeValue("@ZOR2Level"));
    reportFile.CopyAttribute("@ZOR2Usage", file.getAttributeValue("@ZOR2Usage"));
  }
  reportFile.CopyAttribute("Aut", file.getAttributeValue("Aut"));
}

// A usage may stay the same or move from U1 to U2 and from U3 to U4 or U5; it
// may not disappear.
bool AllowedUsageChange(std::string_view reference, std::string_view checked) {
  if (checked.empty()) return false;
  if (checked == reference) return true;
  if (reference == "U1") return checked == "U2";
  if (reference == "U3") return checked == "U4" || checked == "U5";
  return false;
}

bool SameLevel(const char* reference, const char* checked) {
  return checked != nullptr && reference != nullptr && std::strcmp(reference, checked) == 0;
}

// Applies the level and usage rules to a flagged file pair and answers whether
// its classes must be checked for new pure virtual methods.
int CheckLevelAndUsage(const QEXVBTXMLNode& reference, const QEXVBTXMLNode& checked,
                       ReportMirror& reportFile) {
  const bool exempt = RecentlyDeprecatedFile(reference);
  if (!SameLevel(reference.getAttributeValue("@ZOR2Level"),
                 checked.getAttributeValue("@ZOR2Level")) &&
      !exempt) {
    AddError(reportFile, "LHC");
  }

  const std::string_view referenceUsage = FirstWord(reference.getAttributeValue("@ZOR2Usage"));
  const std::string_view checkedUsage = FirstWord(checked.getAttributeValue("@ZOR2Usage"));
  if (referenceUsage.empty()) {
    ZORerr << " Warning : File " << reference.getAttributeValue("Name")
           << " is L1 and has no ZOR2Usage " << endl;
  } else if (!AllowedUsageChange(referenceUsage, checkedUsage) && !exempt) {
    AddError(reportFile, "UHC");
  }
  // Classes of usage U2 or U5 must not gain pure virtual methods, even
  // when the usage change itself was forbidden.
  return checkedUsage == "U2" || checkedUsage == "U5";
}

}  // namespace

bool RecentlyDeprecatedFile(const QEXVBTXMLNode& file) {
  const std::vector<QEXVBTXMLNode*> classes = ChildElements(&file, "Class");
  if (classes.empty()) return false;
  for (const QEXVBTXMLNode* cls : classes) {
    if (!RecentlyDeprecatedClass(*cls)) return false;
  }
  return true;
}

int CompareInterfaceFiles(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                          ReportMirror& report, const char* group) {
  // The group is mirrored before any file is examined, even when empty.
  ReportMirror reportGroup(report, "Interfaces");
  reportGroup.CopyAttribute("Name", group);

  using S = QEXVBTXMLSearch;
  QEXVBTXMLSearch referenceQuery;
  referenceQuery.setSearch({S::SearchChildren, S::TagIs, "Interfaces", S::AttrIs, "Name", group,
                            S::SearchChildren, S::TagIs, "File", S::HasAttr,
                            OnlyFlaggedFiles ? "@ZOR2Level" : "Aut"});
  referenceQuery.searchStart(reference);
  QEXVBTXMLSearch checkedQuery;
  checkedQuery.setSearch({S::SearchChildren, S::TagIs, "Interfaces", S::AttrIs, "Name", group,
                          S::SearchChildren, S::TagIs, "File"});
  checkedQuery.searchStart(checked);
  if (referenceQuery.matches().empty()) return 0;

  const NameIndex checkedFiles(checkedQuery.matches());
  for (const QEXVBTXMLNode* file : referenceQuery.matches()) {
    if (!PassesFileFilter(*file)) continue;
    ReportMirror reportFile(reportGroup, "File");
    MirrorFile(reportFile, *file);

    const QEXVBTXMLNode* counterpart = checkedFiles.Find(file->getAttributeValue("Name"));
    if (counterpart == nullptr) {
      if (!RecentlyDeprecatedFile(*file)) AddError(reportFile, "FHBD");
      continue;
    }
    int checkNewPureVirtual = 0;
    if (OnlyFlaggedFiles) checkNewPureVirtual = CheckLevelAndUsage(*file, *counterpart, reportFile);
    CompareClasses(file, counterpart, reportFile, checkNewPureVirtual);
  }
  return 0;
}
