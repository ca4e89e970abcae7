#include "rules/ClassComparison.h"

#include "platform/xml/QEXVBTXMLSearch.h"
#include "rules/MethodComparison.h"
#include "rules/NewPureVirtualMethods.h"
#include "rules/PairingIndex.h"

int CompareClasses(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                   ReportMirror& report, int checkNewPureVirtual) {
  QEXVBTXMLSearch referenceQuery;
  referenceQuery.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Class"});
  referenceQuery.searchStart(reference);
  QEXVBTXMLSearch checkedQuery;
  checkedQuery.setSearch({QEXVBTXMLSearch::SearchChildren, QEXVBTXMLSearch::TagIs, "Class"});
  checkedQuery.searchStart(checked);
  if (referenceQuery.matches().empty()) return 0;

  const NameIndex checkedClasses(checkedQuery.matches());
  for (const QEXVBTXMLNode* cls : referenceQuery.matches()) {
    const char* name = cls->getAttributeValue("Name");
    ReportMirror reportClass(report, "Class");
    reportClass.CopyAttribute("Name", name);

    // A deprecated class is no exception: deleting it is reported as well.
    const QEXVBTXMLNode* counterpart = checkedClasses.Find(name);
    if (counterpart == nullptr) {
      AddError(reportClass, "CHBD");
      continue;
    }
    CompareMethods(cls, counterpart, reportClass);
    if (checkNewPureVirtual) CheckNewPureVirtualMethods(cls, counterpart, reportClass);
  }
  return 0;
}
