#include "rules/new_pure_virtual_methods.h"

#include "rules/method_lists.h"
#include "rules/pairing_index.h"

namespace zor2 {

void CheckNewPureVirtualMethods(const std::vector<MethodRecord>& reference_methods,
                                const std::vector<MethodRecord>& checked_methods,
                                ReportMirror& report, Log& log) {
  const std::vector<const MethodRecord*> reference_list =
      PureVirtualMethods(reference_methods, ClassSide::kReference, log);
  const std::vector<const MethodRecord*> checked_list =
      PureVirtualMethods(checked_methods, ClassSide::kChecked, log);
  if (checked_list.empty()) return;

  const MethodIndex declared(reference_list);
  for (const MethodRecord* method : checked_list) {
    const MethodRecord& n = *method;
    if (declared.Contains(n)) continue;
    ReportMirror report_method(report, "Method");
    MirrorMethod(report_method, n);
    report_method.SetCounterpart(n.element);
    AddError(report_method, MessageCode::kNPVM);
  }
}

}  // namespace zor2
