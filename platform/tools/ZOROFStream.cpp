#include "platform/tools/ZOROFStream.h"

#include <cerrno>

#include "platform/tools/Numbers.h"

// The log streams are built before any other static object of the program, so
// that a start-up step of another file can already write to them; their
// destructors flush them when the process ends normally.
#if defined(__GNUC__)
ZOROFStream ZORout __attribute__((init_priority(101))) (stdout);
ZOROFStream ZORerr __attribute__((init_priority(101))) (stderr);
#else
ZOROFStream ZORout(stdout);
ZOROFStream ZORerr(stderr);
#endif

namespace {

// Keeps the first failure only: later ones are usually its consequences.
void Remember(int& error, int err) {
  if (error == 0) error = err != 0 ? err : EIO;
}

// The log that the standard streams write to on this thread instead of their
// files, if any.
thread_local ZORLog* capturing = nullptr;

}  // namespace

ZORLogCapture::ZORLogCapture(ZORLog& log) : previous_(capturing) {
  capturing = &log;
}

ZORLogCapture::~ZORLogCapture() {
  capturing = previous_;
}

void ZORLog::Hold(ZOROFStream* stream, std::string_view text, bool endsLine) {
  if (pieces_.empty() || pieces_.back().stream != stream || pieces_.back().endsLine) {
    pieces_.push_back({stream, {}, false});
  }
  pieces_.back().text += text;
  pieces_.back().endsLine = endsLine;
}

void ZORLog::Replay() {
  for (const Piece& piece : pieces_) {
    *piece.stream << piece.text;
    // What endl does after its line feed, which is in the text.
    if (piece.endsLine) piece.stream->flush();
  }
  pieces_.clear();
}

ZOROFStream::~ZOROFStream() {
  close();
}

int ZOROFStream::open(const char* path, int /*mode*/) {
  close();
  error_ = 0;
  if (path == nullptr) {
    errno = EINVAL;
    return 1;
  }
  file_ = std::fopen(path, "wb");
  if (file_ == nullptr) return 1;
  owned_ = true;
  return 0;
}

int ZOROFStream::close() {
  if (file_ == nullptr) return error_ != 0;
  flush();
  // A borrowed standard stream stays attached: only flushed, never closed.
  if (!owned_) return error_ != 0;
  if (std::fclose(file_) != 0) Remember(error_, errno);
  file_ = nullptr;
  owned_ = false;
  return error_ != 0;
}

int ZOROFStream::flush() {
  if (file_ != nullptr && std::fflush(file_) != 0) Remember(error_, errno);
  return error_ != 0;
}

ZOROFStream& ZOROFStream::operator<<(std::string_view text) {
  if (file_ == nullptr || text.empty()) return *this;
  if (!owned_ && capturing != nullptr) {
    capturing->Hold(this, text, false);
    return *this;
  }
  if (std::fwrite(text.data(), 1, text.size(), file_) != text.size()) Remember(error_, errno);
  return *this;
}

ZOROFStream& ZOROFStream::operator<<(int value) {
  return *this << toString(value);
}

ZOROFStream& ZOROFStream::operator<<(ZOREndl) {
  if (file_ != nullptr && !owned_ && capturing != nullptr) {
    capturing->Hold(this, "\n", true);
    return *this;
  }
  *this << std::string_view("\n");
  // A standard stream is flushed line by line, so that the lines of the two
  // log streams keep their order when both go to the same place.
  if (!owned_) flush();
  return *this;
}
