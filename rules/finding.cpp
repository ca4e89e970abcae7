#include "rules/finding.h"

#include <optional>

#include "platform/tools/xml_escaping.h"

namespace zor2 {

// A value that preparation left alone is as the document wrote it; one it
// changed is shown from its original, whose references are decoded as
// preparation would have decoded them.
std::string FindingCollector::AsWritten(const char* value) const {
  if (value == nullptr) return {};
  for (const xml::OriginalValues* originals : {reference_, checked_}) {
    if (originals == nullptr) continue;
    if (std::optional<std::string_view> original = originals->Find(value)) {
      std::string decoded;
      if (DecodeXmlReferences(*original, &decoded)) return decoded;
      return std::string(*original);
    }
  }
  return value;
}

std::string ReportStep(std::string_view tag, const char* name, const char* signature) {
  // Separators that no value holds as written: values with control
  // characters are escaped in the report, which the baseline reader decodes.
  std::string step(tag);
  step += '\x1f';
  if (name != nullptr) step += name;
  if (tag == "Method") {
    step += '\x1f';
    if (signature != nullptr) step += signature;
  }
  step += '\x1e';
  return step;
}

}  // namespace zor2
