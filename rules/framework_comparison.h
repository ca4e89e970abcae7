#pragma once

#include "platform/tools/executor.h"
#include "platform/tools/log.h"
#include "platform/xml/document.h"
#include "platform/xml/output_element.h"
#include "rules/check_settings.h"
#include "rules/finding.h"

namespace zor2 {

// Compares the frameworks of one document pair: pairs reference and checked
// "Framework" elements by name and, for each pair, compares the "Public" and
// then the "Protected" interface groups, recording the findings under
// `report`, each under the mirrors of the reference elements that lead to it.
// A reference framework without counterpart is passed over (and named to the
// collector, when there is one). The framework pairs are compared on the
// calling thread and, given an `executor`, on as many of its workers as there
// are other processors; the report and the lines written to `log` come out in
// reference order all the same. With a `collector`, every finding is also
// collected there, in report order, and the reference files that passed the
// file filter are counted there.
void CompareFrameworks(const xml::Element& reference, const xml::Element& checked,
                       const CheckSettings& settings, xml::OutputElement& report, Log& log,
                       FindingCollector* collector = nullptr, Executor* executor = nullptr);

}  // namespace zor2
