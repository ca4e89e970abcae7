#pragma once

#include <cstddef>
#include <cstdio>
#include <string>
#include <string_view>
#include <vector>

namespace zor2 {

// The program's two log streams: progress lines go to standard output,
// warnings and errors to standard error.
enum class LogStream { kProgress, kWarnings };

class Log;

// Text that comes from outside the program: a path, an argument, a name or a
// value read from a document or the baseline, a reason the system gives, or a
// text made of such pieces. A log line writes it with its control characters
// escaped (AppendPrintable), so that nothing read can split a line or forge
// one ("...\nERROR: ..."). Every text but the program's own literals reaches
// a log line as one: the conversions below make it so.
class OutsideText {
 public:
  OutsideText(std::string_view text) : text_(text) {}
  OutsideText(const std::string& text) : text_(text) {}
  // A null text is empty.
  OutsideText(const char* text) : text_(text != nullptr ? text : "") {}

  std::string_view text() const { return text_; }

 private:
  std::string_view text_;
};

// One line being written to a log; the line is ended (and handed to the log)
// when this object goes, at the end of the statement that wrote it:
//   log.Warning() << "  No Access found for method (ref) : " << name;
// Only string literals are written as they are; any other text is outside
// text, escaped.
class LogLine {
 public:
  LogLine(Log* log, LogStream stream) : log_(log), stream_(stream) {}
  LogLine(const LogLine&) = delete;
  LogLine& operator=(const LogLine&) = delete;
  ~LogLine();

  // The program's own words.
  template <size_t N>
  LogLine& operator<<(const char (&literal)[N]) {
    text_ += std::string_view(literal);
    return *this;
  }
  LogLine& operator<<(OutsideText text);
  LogLine& operator<<(int value) {
    text_ += std::to_string(value);
    return *this;
  }

 private:
  Log* log_;
  LogStream stream_;
  std::string text_;
};

// Where log lines go: either straight to the process's standard streams
// (Log::Standard()), or held back in a log of their own until they are
// replayed into another log, so that work done on several threads shows its
// lines in the order one thread would have written them.
//
// Thread safety: a log is written by one thread at a time. The standard log is
// written only by the thread that runs the program; work on other threads
// writes to held-back logs of its own.
class Log {
 public:
  // A log that holds its lines back.
  Log() = default;
  Log(const Log&) = delete;
  Log& operator=(const Log&) = delete;

  // The log that writes each line at once to standard output or standard
  // error, flushing it there, so that the lines of the two streams keep their
  // order when both go to the same place. A stream that cannot be written (a
  // closed pipe) is given up after its first failure.
  static Log& Standard();

  LogLine Progress() { return LogLine(this, LogStream::kProgress); }
  LogLine Warning() { return LogLine(this, LogStream::kWarnings); }

  // Hands the held lines to `target`, in the order they were written, and
  // forgets them.
  void ReplayInto(Log& target);

 private:
  friend class LogLine;
  struct Line {
    LogStream stream;
    std::string text;
  };
  explicit Log(bool standard) : standard_(standard) {}
  void Write(LogStream stream, std::string text);

  bool standard_ = false;
  std::vector<Line> held_;
  bool progress_failed_ = false;  // of the standard log's streams
  bool warnings_failed_ = false;
};

}  // namespace zor2
