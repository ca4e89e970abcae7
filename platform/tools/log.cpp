#include "platform/tools/log.h"

#include <utility>

namespace zor2 {

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
  std::FILE* file = stream == LogStream::kProgress ? stdout : stderr;
  text += '\n';
  std::fwrite(text.data(), 1, text.size(), file);
  std::fflush(file);
}

void Log::ReplayInto(Log& target) {
  for (Line& line : held_) target.Write(line.stream, std::move(line.text));
  held_.clear();
}

}  // namespace zor2
