#pragma once

#include <string>
#include <vector>

#include "documents/findings.h"

namespace zor2 {

// The SARIF 2.1.0 export for code-scanning services: one rule per message
// type, one result per finding with the header file as its artifact, the
// Framework/Class/Method chain as its logical location and a fingerprint that
// stays the same from run to run; accepted findings are suppressed results.
std::string ExportSarif(const RunDescription& run, const RunSummary& summary,
                        const std::vector<Finding>& findings);

// The finding's fingerprint: a hash of its code and of the chain of names
// that places it (framework, group, file, class, signature or method name,
// argument), followed, for the second and later of several findings with the
// same chain, by its rank among them. Neither the values nor the order of
// unrelated findings change it.
std::string FindingFingerprint(const Finding& finding, int occurrence);

}  // namespace zor2
