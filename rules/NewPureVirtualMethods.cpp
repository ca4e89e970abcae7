#include "rules/NewPureVirtualMethods.h"

#include "rules/MethodLists.h"
#include "rules/PairingIndex.h"
#include "rules/ReportMirror.h"
#include "rules/ZOR2Error.h"

int CheckNewPureVirtualMethods(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                               QEXVBTXMLNode* report) {
  if (reference == nullptr || checked == nullptr) return 0;
  const RecordList<MethodInfo> referenceMethods =
      PureVirtualMethods(*reference, ClassSide::Reference);
  const RecordList<MethodInfo> checkedMethods = PureVirtualMethods(*checked, ClassSide::Checked);
  if (checkedMethods.empty()) return 0;

  const MethodIndex declared(referenceMethods);
  for (const MethodInfo& n : checkedMethods) {
    if (declared.Contains(n)) continue;
    QEXVBTXMLNode* reportMethod = MirrorMethod(report, n);
    AddError(reportMethod, "NPVM");
  }
  return 0;
}
