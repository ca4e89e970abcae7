#include "platform/tools/log.h"

#include <utility>

#include "platform/tools/printable_path.h"

namespace zor2 {

LogLine& LogLine::operator<<(OutsideText text) {
  AppendPrintable(text.text(), &text_);
  return *this;
}

LogLine::~LogLine() {
  log_->Write(stream_, std::move(text_));
}

Log& Log::Standard() {
  static Log standard(true);
  return standard;
}

void Log::Write(LogStream stream, std::string text) {
  if (!standard_) {
    held_.push_back({stream, std::move(text)});
    return;
  }
  const bool progress = stream == LogStream::kProgress;
  // A stream that failed once (a closed pipe, a full disk) is not written to
  // again: the run goes on without it.
  bool& failed = progress ? progress_failed_ : warnings_failed_;
  if (failed) return;
  std::FILE* file = progress ? stdout : stderr;
  text += '\n';
  if (std::fwrite(text.data(), 1, text.size(), file) != text.size() || std::fflush(file) != 0) {
    failed = true;
  }
}

void Log::ReplayInto(Log& target) {
  for (Line& line : held_) target.Write(line.stream, std::move(line.text));
  held_.clear();
}

}  // namespace zor2
