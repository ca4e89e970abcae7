#include "rules/class_comparison.h"

#include "rules/child_elements.h"
#include "rules/method_comparison.h"
#include "rules/method_lists.h"
#include "rules/new_pure_virtual_methods.h"
#include "rules/pairing_index.h"

namespace zor2 {

void CompareClasses(const xml::Element& reference, const xml::Element& checked,
                    bool check_new_pure_virtual, const CheckSettings& settings,
                    ReportMirror& report, Log& log) {
  const std::vector<const xml::Element*> reference_classes = ChildElements(reference, "Class");
  if (reference_classes.empty()) return;

  const NameIndex checked_classes(ChildElements(checked, "Class"));
  for (const xml::Element* cls : reference_classes) {
    const char* name = cls->FindAttribute("Name");
    ReportMirror report_class(report, "Class");
    report_class.CopyAttribute("Name", name);

    // A deprecated class is no exception: deleting it is reported as well.
    const xml::Element* counterpart = checked_classes.Find(name);
    if (counterpart == nullptr) {
      AddError(report_class, MessageCode::kCHBD);
      continue;
    }
    report_class.SetCounterpart(counterpart);
    // Read once for both method rules.
    const std::vector<MethodRecord> reference_methods = ReadClassMethods(*cls);
    const std::vector<MethodRecord> checked_methods = ReadClassMethods(*counterpart);
    CompareMethods(*cls, *counterpart, reference_methods, checked_methods, settings, report_class,
                   log);
    if (check_new_pure_virtual) {
      CheckNewPureVirtualMethods(reference_methods, checked_methods, report_class, log);
    }
  }
}

}  // namespace zor2
