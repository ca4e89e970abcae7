#pragma once

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <mutex>
#include <string>
#include <thread>

namespace zor2::describe {

// A line on standard error that says how far the compilation of the headers
// has come: translation units compiled out of those started, and the time
// spent. Shown only when standard error is a terminal, once the work has
// taken more than two seconds, rewritten in place a few times a second (also
// while one long unit is being compiled), and ended when this object goes.
//
// Thread safety: AddWork and Advance may be called from any thread.
class ProgressLine {
 public:
  ProgressLine(std::string program, bool enabled);
  ~ProgressLine();
  ProgressLine(const ProgressLine&) = delete;
  ProgressLine& operator=(const ProgressLine&) = delete;

  // More translation units to compile.
  void AddWork(size_t units);
  // One more unit compiled.
  void Advance();

 private:
  using Clock = std::chrono::steady_clock;

  void Tick();                                    // the thread that rewrites the line
  void Show(std::unique_lock<std::mutex>& lock);  // REQUIRES: `lock` holds mutex_

  std::mutex mutex_;
  std::condition_variable stop_wanted_;
  const std::string program_;
  const Clock::time_point start_ = Clock::now();
  size_t total_ = 0;
  size_t done_ = 0;
  bool shown_ = false;
  bool stopping_ = false;
  std::thread ticker_;
};

}  // namespace zor2::describe
