#include "rules/NewPureVirtualMethods.h"

#include "rules/MethodLists.h"
#include "rules/PairingIndex.h"

int CheckNewPureVirtualMethods(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                               ReportMirror& report) {
  if (reference == nullptr || checked == nullptr) return 0;
  const RecordList<MethodInfo> referenceMethods =
      PureVirtualMethods(*reference, ClassSide::Reference);
  const RecordList<MethodInfo> checkedMethods = PureVirtualMethods(*checked, ClassSide::Checked);
  if (checkedMethods.empty()) return 0;

  const MethodIndex declared(referenceMethods);
  for (const MethodInfo& n : checkedMethods) {
    if (declared.Contains(n)) continue;
    ReportMirror reportMethod(report, "Method");
    MirrorMethod(reportMethod, n);
    AddError(reportMethod, "NPVM");
  }
  return 0;
}
