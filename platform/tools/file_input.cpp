#include "platform/tools/file_input.h"

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/sysinfo.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <limits>

namespace zor2 {
namespace {

bool Refuse(FileReadError* err, int error_number) {
  err->reason = std::strerror(error_number);
  return false;
}

}  // namespace

uintmax_t MemoryLimit() {
  uintmax_t limit = std::numeric_limits<uintmax_t>::max();
  struct sysinfo machine;
  if (::sysinfo(&machine) == 0) {
    limit = (uintmax_t{machine.totalram} + machine.totalswap) * machine.mem_unit;
  }
  for (int resource : {RLIMIT_AS, RLIMIT_DATA}) {
    struct rlimit process;
    if (::getrlimit(resource, &process) == 0 && process.rlim_cur != RLIM_INFINITY) {
      limit = std::min<uintmax_t>(limit, process.rlim_cur);
    }
  }
  return limit;
}

bool OpenRegularFile(const std::string& path, uintmax_t memory_limit, FileDescriptor* file,
                     size_t* size, FileReadError* err) {
  *err = FileReadError{};
  *file = FileDescriptor(::open(path.c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
  if (!file->valid()) return Refuse(err, errno);
  struct stat status;
  if (::fstat(file->get(), &status) != 0) return Refuse(err, errno);
  if (S_ISDIR(status.st_mode)) return Refuse(err, EISDIR);
  if (!S_ISREG(status.st_mode)) {
    err->reason = "Not a regular file";
    return false;
  }
  if (static_cast<uintmax_t>(status.st_size) >= memory_limit) {
    err->reason = std::strerror(ENOMEM);
    err->too_large = true;
    return false;
  }
  *size = static_cast<size_t>(status.st_size);
  return true;
}

bool ReadOpenFile(int file, size_t size, const ReadRoom& room, size_t* length, FileReadError* err) {
  size_t limit = size + 1;
  char* buffer = room(limit, 0);
  size_t used = 0;
  for (;;) {
    if (used == limit) {
      limit *= 2;
      buffer = room(limit, used);
    }
    const ssize_t got = ::read(file, buffer + used, limit - used);
    if (got < 0) {
      if (errno == EINTR) continue;
      return Refuse(err, errno);
    }
    if (got == 0) break;
    used += static_cast<size_t>(got);
  }
  *length = used;
  return true;
}

bool ReadRegularFile(const std::string& path, const ReadRoom& room, size_t* length,
                     FileReadError* err) {
  FileDescriptor file(-1);
  size_t size = 0;
  return OpenRegularFile(path, MemoryLimit(), &file, &size, err) &&
         ReadOpenFile(file.get(), size, room, length, err);
}

}  // namespace zor2
