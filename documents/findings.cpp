#include "documents/findings.h"

#include <numeric>

namespace zor2 {

int TotalFindings(const RunSummary& summary) {
  return std::accumulate(summary.counts_by_code.begin(), summary.counts_by_code.end(), 0);
}

}  // namespace zor2
