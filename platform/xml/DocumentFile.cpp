#include "platform/xml/DocumentFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstring>

namespace {

// Closes a descriptor when it goes out of scope, unless released.
class FileDescriptor {
 public:
  explicit FileDescriptor(int fd) : fd_(fd) {}
  FileDescriptor(const FileDescriptor&) = delete;
  FileDescriptor& operator=(const FileDescriptor&) = delete;
  ~FileDescriptor() {
    if (fd_ >= 0) ::close(fd_);
  }
  int get() const { return fd_; }
  // Closes now and reports whether the close succeeded.
  bool Close() {
    int fd = fd_;
    fd_ = -1;
    return ::close(fd) == 0;
  }

 private:
  int fd_;
};

int Fail(std::string& reason, int error_number) {
  reason = std::strerror(error_number);
  return 1;
}

bool Refuse(std::string& reason, int error_number) {
  reason = std::strerror(error_number);
  return false;
}

bool WriteAll(int fd, std::string_view bytes) {
  while (!bytes.empty()) {
    ssize_t written = ::write(fd, bytes.data(), bytes.size());
    if (written < 0) {
      if (errno == EINTR) continue;
      return false;
    }
    bytes.remove_prefix(static_cast<size_t>(written));
  }
  return true;
}

int WriteDirectly(const char* path, std::string_view bytes, std::string& reason) {
  FileDescriptor file(::open(path, O_WRONLY | O_CREAT | O_TRUNC | O_NOCTTY | O_CLOEXEC, 0666));
  if (file.get() < 0) return Fail(reason, errno);
  if (!WriteAll(file.get(), bytes)) return Fail(reason, errno);
  if (!file.Close()) return Fail(reason, errno);
  return 0;
}

// The mode a newly created document gets: 0644 less the process's umask,
// which can only be read by setting it (no other thread creates files while
// a document is written).
mode_t NewFileMode() {
  mode_t mask = ::umask(0);
  ::umask(mask);
  return 0644 & ~mask;
}

}  // namespace

bool ReadDocumentFile(const char* path, TextBuffer& text, std::string& reason) {
  FileDescriptor file(::open(path, O_RDONLY | O_CLOEXEC));
  if (file.get() < 0) return Refuse(reason, errno);
  struct stat status;
  if (::fstat(file.get(), &status) != 0) return Refuse(reason, errno);
  if (S_ISDIR(status.st_mode)) return Refuse(reason, EISDIR);
  // One byte more than a regular file's size, so that its end is seen
  // without growing the buffer; the spare capacity after it takes rewritten
  // values that grew (ParsedDocument).
  size_t limit = S_ISREG(status.st_mode) ? static_cast<size_t>(status.st_size) + 1 : 65536;
  TextBuffer buffer = TextBuffer::Allocate(limit, limit / 4);
  size_t length = 0;
  for (;;) {
    if (length == limit) {
      limit *= 2;
      TextBuffer larger = TextBuffer::Allocate(limit, limit / 4);
      std::memcpy(larger.data(), buffer.data(), length);
      buffer = std::move(larger);
    }
    ssize_t got = ::read(file.get(), buffer.data() + length, limit - length);
    if (got < 0) {
      if (errno == EINTR) continue;
      return Refuse(reason, errno);
    }
    if (got == 0) break;
    length += static_cast<size_t>(got);
  }
  buffer.size = length;
  buffer.bytes[length] = '\0';
  text = std::move(buffer);
  return true;
}

int WriteDocumentFile(const char* path, std::string_view bytes, std::string& reason) {
  if (path == nullptr) return Fail(reason, EINVAL);
  struct stat status;
  bool exists = ::lstat(path, &status) == 0;
  if (exists && !S_ISREG(status.st_mode)) return WriteDirectly(path, bytes, reason);

  std::string temporary = std::string(path) + ".tmpXXXXXX";
  FileDescriptor file(::mkostemp(temporary.data(), O_CLOEXEC));
  if (file.get() < 0) return Fail(reason, errno);
  mode_t mode = exists ? status.st_mode & 07777 : NewFileMode();
  // The mode is a courtesy: a file system that refuses it does not fail the write.
  (void)::fchmod(file.get(), mode);
  int error = 0;
  if (!WriteAll(file.get(), bytes)) error = errno;
  if (!file.Close() && error == 0) error = errno;
  if (error == 0 && ::rename(temporary.c_str(), path) != 0) error = errno;
  if (error == 0) return 0;
  ::unlink(temporary.c_str());
  return Fail(reason, error);
}
