#include "describe/progress_line.h"

#include <unistd.h>

#include <cstdio>
#include <system_error>

namespace zor2::describe {

ProgressLine::ProgressLine(std::string program, bool enabled) : program_(std::move(program)) {
  if (!enabled) return;
  try {
    ticker_ = std::thread([this] { Tick(); });
  } catch (const std::system_error&) {
    // Without a thread there is no progress line; the work goes on.
  }
}

ProgressLine::~ProgressLine() {
  {
    std::lock_guard<std::mutex> lock(mutex_);
    stopping_ = true;
  }
  stop_wanted_.notify_all();
  if (ticker_.joinable()) ticker_.join();
  if (!shown_) return;
  // The finished line stays, ended.
  std::unique_lock<std::mutex> lock(mutex_);
  Show(lock);
  [[maybe_unused]] const ssize_t written = write(STDERR_FILENO, "\n", 1);
}

void ProgressLine::AddWork(size_t units) {
  std::lock_guard<std::mutex> lock(mutex_);
  total_ += units;
}

void ProgressLine::Advance() {
  std::lock_guard<std::mutex> lock(mutex_);
  ++done_;
}

void ProgressLine::Tick() {
  std::unique_lock<std::mutex> lock(mutex_);
  if (stop_wanted_.wait_for(lock, std::chrono::seconds(2), [this] { return stopping_; })) return;
  do {
    Show(lock);
  } while (
      !stop_wanted_.wait_for(lock, std::chrono::milliseconds(250), [this] { return stopping_; }));
}

void ProgressLine::Show(std::unique_lock<std::mutex>&) {
  shown_ = true;
  const auto seconds =
      std::chrono::duration_cast<std::chrono::seconds>(Clock::now() - start_).count();
  const std::string line = "\r" + program_ + ": " + std::to_string(done_) + " of " +
                           std::to_string(total_) + " translation units compiled, " +
                           std::to_string(seconds) + " s";
  [[maybe_unused]] const ssize_t written = write(STDERR_FILENO, line.data(), line.size());
}

}  // namespace zor2::describe
