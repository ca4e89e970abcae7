#include "rules/new_pure_virtual_methods.h"

#include "rules/method_lists.h"
#include "rules/pairing_index.h"

namespace zor2 {

void CheckNewPureVirtualMethods(const xml::Element& reference, const xml::Element& checked,
                                ReportMirror& report, Log& log) {
  const std::vector<MethodRecord> reference_methods =
      PureVirtualMethods(reference, ClassSide::kReference, log);
  const std::vector<MethodRecord> checked_methods =
      PureVirtualMethods(checked, ClassSide::kChecked, log);
  if (checked_methods.empty()) return;

  const MethodIndex declared(reference_methods);
  for (const MethodRecord& n : checked_methods) {
    if (declared.Contains(n)) continue;
    ReportMirror report_method(report, "Method");
    MirrorMethod(report_method, n);
    report_method.SetCounterpart(n.element);
    AddError(report_method, MessageCode::kNPVM);
  }
}

}  // namespace zor2
