#pragma once

#include <cstdio>
#include <string>
#include <string_view>
#include <vector>

// The line-end manipulator of ZOROFStream: writes "\n".
struct ZOREndl {};
inline constexpr ZOREndl endl{};

// An output stream over C stdio: either a file it opened and owns, or one of
// the process's standard streams, which it only borrows and flushes at every
// line end. Write failures are remembered rather than thrown, so that the
// caller can report them once.
class ZOROFStream {
 public:
  ZOROFStream() = default;
  // Borrows `stream` (stdout or stderr); it is never closed by this object.
  explicit ZOROFStream(std::FILE* stream) : file_(stream) {}
  ZOROFStream(const ZOROFStream&) = delete;
  ZOROFStream& operator=(const ZOROFStream&) = delete;
  ~ZOROFStream();

  // Opens `path` for writing, replacing any existing file (mode 8 is the only
  // mode in use; every mode means this). Returns 0 on success; otherwise the
  // stream stays closed and errno tells why.
  int open(const char* path, int mode);
  bool isOpen() const { return file_ != nullptr; }
  // Flushes and, for an owned file, closes it. Returns 0 when every write since
  // open and the close itself succeeded; otherwise non-zero, with the system's
  // reason in error().
  int close();
  // Flushes buffered output; returns 0, or non-zero when a write has failed.
  int flush();
  // The errno of the first failed write, flush or close, 0 when none failed.
  int error() const { return error_; }

  ZOROFStream& operator<<(std::string_view text);
  ZOROFStream& operator<<(const char* text) { return *this << std::string_view(text ? text : ""); }
  ZOROFStream& operator<<(const std::string& text) { return *this << std::string_view(text); }
  ZOROFStream& operator<<(int value);
  ZOROFStream& operator<<(ZOREndl);

 private:
  std::FILE* file_ = nullptr;
  bool owned_ = false;
  int error_ = 0;
};

// The standard log stream (standard output) and the error log stream
// (standard error). Both are flushed before the process ends.
extern ZOROFStream ZORout;
extern ZOROFStream ZORerr;

// Log output held back: what a thread writes to the standard log streams
// while a ZORLogCapture of this log is alive on it. Lets work that runs on
// several threads write its lines in the order one thread would have.
class ZORLog {
 public:
  // Writes the held output to its streams, in the order it was written,
  // flushing at each line end as the streams do, and forgets it. Call it on
  // a thread that is not capturing.
  void Replay();

 private:
  friend class ZOROFStream;
  // Text for one stream, ended by a line end when `endsLine`.
  struct Piece {
    ZOROFStream* stream;
    std::string text;
    bool endsLine;
  };
  void Hold(ZOROFStream* stream, std::string_view text, bool endsLine);
  std::vector<Piece> pieces_;
};

// While alive, holds back in `log` everything the calling thread writes to
// the standard log streams (streams that own a file are not concerned).
// Captures nest: the innermost one holds.
class ZORLogCapture {
 public:
  explicit ZORLogCapture(ZORLog& log);
  ~ZORLogCapture();
  ZORLogCapture(const ZORLogCapture&) = delete;
  ZORLogCapture& operator=(const ZORLogCapture&) = delete;

 private:
  ZORLog* previous_;
};
