#include "rules/method_comparison.h"

#include <cstdint>
#include <cstring>
#include <string>

#include "rules/likely_replacements.h"
#include "rules/method_lists.h"
#include "rules/pairing_index.h"

namespace zor2 {
namespace {

bool StartsWith(const char* value, char first) {
  return value != nullptr && value[0] == first;
}

// A method deprecated more than one release before the checked level may
// disappear or change freely.
bool PassedOverAsDeprecated(const MethodRecord& m, int current_level) {
  return m.deprecated != 0 && int64_t{m.deprecated} + 1 < int64_t{current_level};
}

// Losing the property modifier, or losing "P", breaks automation clients;
// other changes of modifier do not.
bool PropertyModifierChanged(char reference, char checked) {
  return reference != checked && (reference == 'P' || checked == 'N');
}

bool HasRetval(const ArgumentRecord& a) {
  return a.retval != nullptr;
}

// How a finding on argument `k` (from 0) names it.
std::string ArgumentName(size_t k) {
  return "Arg_" + std::to_string(k + 1);
}

void CompareArguments(const MethodRecord& m, const MethodRecord& n, ReportMirror& report_method,
                      Log& log) {
  if (m.args.size() != n.args.size()) {
    // SameMethod paired them, so their argument counts cannot differ.
    log.Warning() << " PB : Methods should be the same, but nb of args are differents";
    return;
  }
  bool retval_reported = false;
  for (size_t k = 0; k < m.args.size(); ++k) {
    const ArgumentRecord& a = m.args[k];
    const ArgumentRecord& b = n.args[k];
    if (!SameDefaultValue(a, b)) {
      const std::string name = ArgumentName(k);
      ReportMirror report_arg(report_method, "Arg");
      report_arg.CopyAttribute("Name", name.c_str());
      report_arg.CopyAttribute("Type", a.type);
      AddError(report_arg, MessageCode::kADVHC, [&](const FindingCollector& shown) {
        return ComparedValues{shown.AsWritten(a.value), shown.AsWritten(b.value)};
      });
    }
    if (!retval_reported && HasRetval(a) != HasRetval(b)) {
      retval_reported = true;
      AddError(report_method, MessageCode::kARVHC, [&](const FindingCollector&) {
        auto marker = [&k](const ArgumentRecord& arg) {
          return ArgumentName(k) + (HasRetval(arg) ? " Retval" : " without Retval");
        };
        return ComparedValues{marker(a), marker(b)};
      });
    }
  }
}

// The rules for a reference method m at position i whose counterpart n is at
// position j of the checked list.
void CompareMethodPair(const MethodRecord& m, size_t i, const MethodRecord& n, size_t j,
                       bool automation, bool& order_reported, ReportMirror& report_method,
                       Log& log) {
  if (automation) {
    if (!order_reported && j != i) {
      order_reported = true;
      AddError(report_method, MessageCode::kMOHBC, [&](const FindingCollector&) {
        return ComparedValues{"position " + std::to_string(i + 1),
                              "position " + std::to_string(j + 1)};
      });
    }
    if (PropertyModifierChanged(m.property, n.property)) {
      AddError(report_method, MessageCode::kPMHC, [&](const FindingCollector& shown) {
        return ComparedValues{shown.AsWritten(m.element->FindAttribute("Property")),
                              shown.AsWritten(n.element->FindAttribute("Property"))};
      });
    }
  }
  if (n.nodoc && !m.nodoc) AddError(report_method, MessageCode::kINDM);
  if (!SameReturnedType(m, n)) {
    AddError(report_method, MessageCode::kMRTHC, [&](const FindingCollector& shown) {
      return ComparedValues{shown.AsWritten(m.returned_type), shown.AsWritten(n.returned_type)};
    });
  }
  CompareArguments(m, n, report_method, log);
}

}  // namespace

void CompareMethods(const xml::Element& reference, const xml::Element& checked,
                    const std::vector<MethodRecord>& reference_methods,
                    const std::vector<MethodRecord>& checked_methods, const CheckSettings& settings,
                    ReportMirror& report, Log& log) {
  const char* reference_aut = reference.FindAttribute("Aut");
  const char* checked_aut = checked.FindAttribute("Aut");
  if (StartsWith(reference_aut, 'Y') && StartsWith(checked_aut, 'N')) {
    AddError(report, MessageCode::kCINMA, [&](const FindingCollector& shown) {
      return ComparedValues{shown.AsWritten(reference_aut), shown.AsWritten(checked_aut)};
    });
  }

  const std::vector<const MethodRecord*> reference_list =
      ComparableMethods(reference_methods, ClassSide::kReference, log);
  const std::vector<const MethodRecord*> checked_list =
      ComparableMethods(checked_methods, ClassSide::kChecked, log);
  if (reference_list.empty()) return;

  const bool automation = StartsWith(checked_aut, 'Y');
  bool order_reported = false;
  const MethodIndex counterparts(checked_list);
  LikelyReplacements replacements(checked_methods);
  for (size_t i = 0; i < reference_list.size(); ++i) {
    const MethodRecord& m = *reference_list[i];
    if (PassedOverAsDeprecated(m, settings.current_level)) continue;
    const size_t j = counterparts.Find(m);
    ReportMirror report_method(report, "Method");
    MirrorMethod(report_method, m);
    if (j == MethodIndex::npos) {
      AddError(report_method, MessageCode::kMHBDM, [&](const FindingCollector& shown) {
        ComparedValues values{shown.AsWritten(m.signature), {}, 0};
        values.checked = replacements.Signatures(m.name, m.signature, shown, &values.more_checked);
        return values;
      });
      continue;
    }
    report_method.SetCounterpart(checked_list[j]->element);
    CompareMethodPair(m, i, *checked_list[j], j, automation, order_reported, report_method, log);
  }
}

}  // namespace zor2
