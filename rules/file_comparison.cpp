#include "rules/file_comparison.h"

#include <cstdint>
#include <cstring>
#include <string_view>

#include "rules/attribute_values.h"
#include "rules/child_elements.h"
#include "rules/class_comparison.h"
#include "rules/pairing_index.h"

namespace zor2 {
namespace {

// A class deprecated at most two releases before the checked level, or later.
bool RecentlyDeprecatedClass(const xml::Element& cls, int current_level) {
  const int release = ReleaseAfterR(cls.FindAttribute("Deprecated"));
  return release != 0 && int64_t{release} + 2 >= int64_t{current_level};
}

// A file whose classes were all deprecated recently is exempt from the file
// rules; a file without classes never is.
bool RecentlyDeprecatedFile(const xml::Element& file, int current_level) {
  const std::vector<const xml::Element*> classes = ChildElements(file, "Class");
  if (classes.empty()) return false;
  for (const xml::Element* cls : classes) {
    if (!RecentlyDeprecatedClass(*cls, current_level)) return false;
  }
  return true;
}

// Only automation files are checked, and with only flagged files only those of
// level "L1".
bool PassesFileFilter(const xml::Element& file, const CheckSettings& settings) {
  if (settings.only_flagged_files && !FirstWordIs(file.FindAttribute("@ZOR2Level"), "L1")) {
    return false;
  }
  return FirstWordIs(file.FindAttribute("Aut"), "Y");
}

void MirrorFile(ReportMirror& report_file, const xml::Element& file,
                const CheckSettings& settings) {
  report_file.CopyAttribute("Name", file.FindAttribute("Name"));
  if (settings.only_flagged_files) {
    report_file.CopyAttribute("@ZOR2Level", file.FindAttribute("@ZOR2Level"));
    report_file.CopyAttribute("@ZOR2Usage", file.FindAttribute("@ZOR2Usage"));
  }
  report_file.CopyAttribute("Aut", file.FindAttribute("Aut"));
}

// A usage may stay the same or move from U1 to U2 and from U3 to U4 or U5; it
// may not disappear.
bool AllowedUsageChange(std::string_view reference, std::string_view checked) {
  if (checked.empty()) return false;
  if (checked == reference) return true;
  if (reference == "U1") return checked == "U2";
  if (reference == "U3") return checked == "U4" || checked == "U5";
  return false;
}

bool SameLevel(const char* reference, const char* checked) {
  return checked != nullptr && reference != nullptr && std::strcmp(reference, checked) == 0;
}

// Applies the level and usage rules to a flagged file pair and answers whether
// its classes must be checked for new pure virtual methods.
bool CheckLevelAndUsage(const xml::Element& reference, const xml::Element& checked, bool exempt,
                        ReportMirror& report_file, Log& log) {
  const char* reference_level = reference.FindAttribute("@ZOR2Level");
  const char* checked_level = checked.FindAttribute("@ZOR2Level");
  if (!SameLevel(reference_level, checked_level) && !exempt) {
    AddError(report_file, MessageCode::kLHC, [&](const FindingCollector& shown) {
      return ComparedValues{shown.AsWritten(reference_level), shown.AsWritten(checked_level)};
    });
  }
  const char* reference_usage_value = reference.FindAttribute("@ZOR2Usage");
  const char* checked_usage_value = checked.FindAttribute("@ZOR2Usage");
  const std::string_view reference_usage = FirstWord(reference_usage_value);
  const std::string_view checked_usage = FirstWord(checked_usage_value);
  if (reference_usage.empty()) {
    log.Warning() << " Warning : File " << reference.FindAttribute("Name")
                  << " is L1 and has no ZOR2Usage ";
  } else if (!AllowedUsageChange(reference_usage, checked_usage) && !exempt) {
    AddError(report_file, MessageCode::kUHC, [&](const FindingCollector& shown) {
      return ComparedValues{shown.AsWritten(reference_usage_value),
                            shown.AsWritten(checked_usage_value)};
    });
  }
  // Classes of usage U2 or U5 must not gain pure virtual methods, even when
  // the usage change itself was forbidden.
  return checked_usage == "U2" || checked_usage == "U5";
}

}  // namespace

void CompareInterfaceFiles(const xml::Element& reference, const xml::Element& checked,
                           const char* group, const CheckSettings& settings, ReportMirror& report,
                           Log& log) {
  ReportMirror report_group(report, "Interfaces");
  report_group.CopyAttribute("Name", group);

  const NameIndex checked_files(GroupFiles(checked, group, nullptr));
  const char* required = settings.only_flagged_files ? "@ZOR2Level" : "Aut";
  for (const xml::Element* file : GroupFiles(reference, group, required)) {
    if (!PassesFileFilter(*file, settings)) continue;
    if (FindingCollector* collector = report.collector()) collector->CountCheckedFiles(1);
    ReportMirror report_file(report_group, "File");
    MirrorFile(report_file, *file, settings);

    const xml::Element* counterpart = checked_files.Find(file->FindAttribute("Name"));
    if (counterpart == nullptr) {
      if (!RecentlyDeprecatedFile(*file, settings.current_level)) {
        AddError(report_file, MessageCode::kFHBD);
      }
      continue;
    }
    report_file.SetCounterpart(counterpart);
    bool check_new_pure_virtual = false;
    if (settings.only_flagged_files) {
      const bool exempt = RecentlyDeprecatedFile(*file, settings.current_level);
      check_new_pure_virtual = CheckLevelAndUsage(*file, *counterpart, exempt, report_file, log);
    }
    CompareClasses(*file, *counterpart, check_new_pure_virtual, settings, report_file, log);
  }
}

}  // namespace zor2
