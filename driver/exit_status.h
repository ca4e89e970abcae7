#pragma once

namespace zor2 {

// The process's exit statuses. Findings change the status only when "-fail"
// asks them to; otherwise it says how far the program could do what it was
// asked.
enum class ExitStatus : int {
  // The run did all it was asked, whatever it found; also after "-h".
  kDone = 0,
  // A usage error, or an argument file that cannot be read: nothing was run.
  kUsageError = 1,
  // The run went on, but an input could not be read or an output could not be
  // written.
  kIncomplete = 2,
  // With "-fail": the run did all it was asked, and found what the baseline
  // does not accept.
  kFindingsNotAccepted = 3,
};

}  // namespace zor2
