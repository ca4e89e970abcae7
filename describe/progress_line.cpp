#include "describe/progress_line.h"

#include <unistd.h>

#include <string>

namespace zor2::describe {

ProgressLine::ProgressLine(std::string program, bool enabled)
    : program_(std::move(program)), enabled_(enabled) {}

ProgressLine::~ProgressLine() {
  if (!shown_) return;
  const std::string end = "\n";
  [[maybe_unused]] ssize_t written = write(STDERR_FILENO, end.data(), end.size());
}

void ProgressLine::AddWork(size_t headers) {
  std::lock_guard<std::mutex> lock(mutex_);
  total_ += headers;
}

void ProgressLine::Advance() {
  std::lock_guard<std::mutex> lock(mutex_);
  ++done_;
  if (!enabled_) return;
  const Clock::time_point now = Clock::now();
  if (now - start_ < std::chrono::seconds(2)) return;
  if (shown_ && now - last_shown_ < std::chrono::milliseconds(200) && done_ != total_) return;
  last_shown_ = now;
  shown_ = true;
  const std::string line = "\r" + program_ + ": " + std::to_string(done_) + " of " +
                           std::to_string(total_) + " headers compiled one by one";
  [[maybe_unused]] ssize_t written = write(STDERR_FILENO, line.data(), line.size());
}

}  // namespace zor2::describe
