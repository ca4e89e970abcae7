#include "rules/ClassComparison.h"

#include "rules/ChildElements.h"
#include "rules/MethodComparison.h"
#include "rules/NewPureVirtualMethods.h"
#include "rules/PairingIndex.h"

int CompareClasses(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                   ReportMirror& report, int checkNewPureVirtual) {
  const std::vector<QEXVBTXMLNode*> referenceClasses = ChildElements(reference, "Class");
  if (referenceClasses.empty()) return 0;

  const NameIndex checkedClasses(ChildElements(checked, "Class"));
  for (const QEXVBTXMLNode* cls : referenceClasses) {
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
