#include "rules/MethodComparison.h"

#include <cstdint>

#include "platform/tools/Numbers.h"
#include "platform/tools/QEXFatalError.h"
#include "platform/tools/ZOROFStream.h"
#include "rules/CheckSettings.h"
#include "rules/MethodLists.h"
#include "rules/PairingIndex.h"

namespace {

bool StartsWith(const char* value, char first) {
  return value != nullptr && value[0] == first;
}

// A method deprecated more than one release before the checked level may
// disappear or change freely.
bool PassedOverAsDeprecated(const MethodInfo& m) {
  return m.deprecated != 0 && int64_t{m.deprecated} + 1 < int64_t{CurrentLevel};
}

// Losing the property modifier, or losing "P", breaks automation clients;
// other changes of modifier do not.
bool PropertyModifierChanged(char reference, char checked) {
  return reference != checked && (reference == 'P' || checked == 'N');
}

void CompareArguments(const MethodInfo& m, const MethodInfo& n, ReportMirror& reportMethod) {
  if (m.args.size() != n.args.size()) {
    // SameMethod paired them, so their argument counts cannot differ.
    ZORerr << " PB : Methods should be the same, but nb of args are differents" << endl;
    return;
  }
  bool retvalReported = false;
  for (size_t k = 0; k < m.args.size(); ++k) {
    const ArgInfo& a = m.args[k];
    const ArgInfo& b = n.args[k];
    if (!SameDefaultValue(a, b)) {
      const std::string name = "Arg_" + toString(static_cast<int>(k + 1));
      ReportMirror reportArg(reportMethod, "Arg");
      reportArg.CopyAttribute("Name", name.c_str());
      reportArg.CopyAttribute("Type", a.type);
      AddError(reportArg, "ADVHC");
    }
    if (!retvalReported && HasRetval(a) != HasRetval(b)) {
      retvalReported = true;
      AddError(reportMethod, "ARVHC");
    }
  }
}

// The rules for a reference method m at position i whose counterpart n is at
// position j of the checked list.
void CompareMethodPair(const MethodInfo& m, size_t i, const MethodInfo& n, size_t j,
                       bool automation, bool& orderReported, ReportMirror& reportMethod) {
  if (automation) {
    if (!orderReported && j != i) {
      orderReported = true;
      AddError(reportMethod, "MOHBC");
    }
    if (PropertyModifierChanged(m.property, n.property)) AddError(reportMethod, "PMHC");
  }
  if (n.nodoc && !m.nodoc) AddError(reportMethod, "INDM");
  if (!SameReturnedType(m, n)) AddError(reportMethod, "MRTHC");
  CompareArguments(m, n, reportMethod);
}

}  // namespace

int CompareMethods(const QEXVBTXMLNode* reference, const QEXVBTXMLNode* checked,
                   ReportMirror& report) {
  if (reference == nullptr || checked == nullptr) return 1;
  const char* referenceAut = reference->getAttributeValue("Aut");
  const char* checkedAut = checked->getAttributeValue("Aut");
  if (StartsWith(referenceAut, 'Y') && StartsWith(checkedAut, 'N')) AddError(report, "CINMA");

  const RecordList<MethodInfo> referenceMethods =
      ComparableMethods(*reference, ClassSide::Reference);
  const RecordList<MethodInfo> checkedMethods = ComparableMethods(*checked, ClassSide::Checked);
  const bool automation = StartsWith(checkedAut, 'Y');
  bool orderReported = false;
  if (referenceMethods.empty()) return 0;

  const MethodIndex counterparts(checkedMethods);
  for (size_t i = 0; i < referenceMethods.size(); ++i) {
    const MethodInfo& m = referenceMethods[i];
    if (PassedOverAsDeprecated(m)) continue;
    const size_t j = counterparts.Find(m);
    ReportMirror reportMethod(report, "Method");
    MirrorMethod(reportMethod, m);
    if (j == MethodIndex::npos) {
      AddError(reportMethod, "MHBDM");
      continue;
    }
    const MethodInfo* n = j < checkedMethods.size() ? &checkedMethods[j] : nullptr;
    if (n == nullptr) QEXFatalError("AssertionFailed:cMet != 0", __FILE__, __LINE__);
    CompareMethodPair(m, i, *n, j, automation, orderReported, reportMethod);
  }
  return 0;
}
