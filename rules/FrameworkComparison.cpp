#include "rules/FrameworkComparison.h"

#include "platform/tools/ZOROFStream.h"
#include "platform/xml/QEXVBTXMLSearch.h"
#include "rules/FileComparison.h"
#include "rules/PairingIndex.h"
#include "rules/ReportMirror.h"

int CompareFrameworks(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                      QEXVBTXMLNode*& report) {
  QEXVBTXMLSearch referenceQuery;
  referenceQuery.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Framework"});
  referenceQuery.searchStart(reference);
  QEXVBTXMLSearch checkedQuery;
  checkedQuery.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Framework"});
  checkedQuery.searchStart(checked);
  if (referenceQuery.matches().empty()) return 0;

  const NameIndex checkedFrameworks(checkedQuery.matches());
  for (const QEXVBTXMLNode* framework : referenceQuery.matches()) {
    const char* name = framework->getAttributeValue("Name");
    QEXVBTXMLNode* reportFramework = MirrorElement(report, "Framework");
    MirrorAttribute(reportFramework, "Name", name);

    // A framework without counterpart is passed over: its empty mirror is
    // pruned from the report.
    const QEXVBTXMLNode* counterpart = checkedFrameworks.Find(name);
    if (counterpart == nullptr) continue;
    ZORout << "Checking : " << name << endl;
    CompareInterfaceFiles(framework, counterpart, reportFramework, "Public");
    CompareInterfaceFiles(framework, counterpart, reportFramework, "Protected");
  }
  return 0;
}
