#pragma once

#include <chrono>
#include <cstddef>
#include <mutex>
#include <string>

namespace zor2::describe {

// A line on standard error that counts the headers compiled, shown only when
// standard error is a terminal and the work has taken more than two seconds,
// and rewritten in place at most a few times a second.
//
// Thread safety: AddWork and Advance may be called from any thread.
class ProgressLine {
 public:
  ProgressLine(std::string program, bool enabled);
  ~ProgressLine();  // ends the line when one was shown
  ProgressLine(const ProgressLine&) = delete;
  ProgressLine& operator=(const ProgressLine&) = delete;

  // More headers to compile.
  void AddWork(size_t headers);
  // One more header compiled.
  void Advance();

 private:
  using Clock = std::chrono::steady_clock;

  std::mutex mutex_;
  const std::string program_;
  const bool enabled_;
  const Clock::time_point start_ = Clock::now();
  Clock::time_point last_shown_{};
  size_t total_ = 0;
  size_t done_ = 0;
  bool shown_ = false;
};

}  // namespace zor2::describe
