#pragma once

#include <functional>
#include <string>
#include <vector>

#include "documents/run_summary.h"
#include "platform/tools/executor.h"
#include "rules/finding.h"

namespace zor2 {

// Says that `path` could not be done, and why.
using FailureReport = std::function<void(const std::string& path, const std::string& reason)>;

// Writes the exports at `paths`, each made and written by a task of
// `executor`, while `write_others` writes the run's other outputs on the
// calling thread. Every export states the run's failures, and a failure may come after
// it was made (the report, the help page or another export could not be
// written): the exports written before a failure they do not state are then
// written again, until every export written states every failure. An export
// that cannot be made (not enough memory) or written is handed to
// `report_failure`, on the calling thread, which must add it to
// `summary->failures`, as `write_others` must add its own.
void WriteExports(const std::vector<std::string>& paths, const RunDescription& run,
                  const std::vector<Finding>& findings, RunSummary* summary, Executor& executor,
                  const std::function<void()>& write_others, const FailureReport& report_failure);

}  // namespace zor2
