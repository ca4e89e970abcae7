#include "platform/tools/file_output.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <deque>
#include <mutex>
#include <random>

#include "platform/tools/file_descriptor.h"

namespace zor2 {
namespace {

// The temporary files being written, for the signal handler: one slot per
// writer at work, in a list that only grows, so that the handler can walk it
// at any moment. A writer holds a slot from before its temporary file exists
// until the file is renamed or removed, and never waits for one: when every
// slot is taken, it adds one.
struct Slot {
  std::atomic<const char*> temporary{nullptr};
  std::atomic<bool> taken{false};
  Slot* next = nullptr;  // set before the slot joins the list, then never changed
};
std::atomic<Slot*> slots{nullptr};
static_assert(std::atomic<const char*>::is_always_lock_free, "read by a signal handler");
static_assert(std::atomic<Slot*>::is_always_lock_free, "read by a signal handler");

// A slot that no writer holds, added to the list when there is none.
Slot& TakeSlot() {
  for (Slot* slot = slots.load(); slot != nullptr; slot = slot->next) {
    if (!slot->taken.exchange(true)) return *slot;
  }
  // Slots never move or go, for the handler's sake.
  static std::mutex adding;
  static std::deque<Slot> added;
  std::lock_guard<std::mutex> lock(adding);
  Slot& slot = added.emplace_back();
  slot.taken.store(true);
  slot.next = slots.load();
  slots.store(&slot);
  return slot;
}

// One writer's slot, given back when it goes.
class TemporarySlot {
 public:
  TemporarySlot() : slot_(TakeSlot()) {}
  TemporarySlot(const TemporarySlot&) = delete;
  TemporarySlot& operator=(const TemporarySlot&) = delete;
  ~TemporarySlot() {
    Publish(nullptr);
    slot_.taken.store(false);
  }
  // REQUIRES: `path` stays valid until the next Publish.
  void Publish(const char* path) { slot_.temporary.store(path); }

 private:
  Slot& slot_;
};

// What the names of temporary files start with.
std::string& TemporaryPrefix() {
  static std::string prefix = ".zor2check.";
  return prefix;
}

extern "C" void EndInterruptedRun(int signal_number) {
  for (const Slot* slot = slots.load(); slot != nullptr; slot = slot->next) {
    if (const char* temporary = slot->temporary.load()) ::unlink(temporary);
  }
  // The handler was reset on entry: ending by the signal itself tells the
  // parent how the run ended (a shell shows 128 and its number).
  ::raise(signal_number);
}

bool Fail(std::string* err, int error_number) {
  *err = std::strerror(error_number);
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

// The directory part of `path`, with its final "/", or "" for a bare name.
std::string DirectoryOf(const std::string& path) {
  const size_t slash = path.rfind('/');
  return slash == std::string::npos ? "" : path.substr(0, slash + 1);
}

// Creates a new file in the directory of `path`, with `mode` (less the
// umask); sets `temporary` to its name. The name is short and hidden,
// ".zor2check." (or the program's own name) and six random letters, so that it fits wherever
// `path`'s name fits and stays out of listings.
FileDescriptor CreateTemporary(const std::string& path, mode_t mode, TemporarySlot& slot,
                               std::string* temporary) {
  static constexpr char kLetters[] =
      "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789";
  const std::string directory = DirectoryOf(path);
  std::random_device seed;
  std::minstd_rand random(seed());
  for (int attempt = 0; attempt < 100; ++attempt) {
    std::string name = directory + TemporaryPrefix();
    for (int i = 0; i < 6; ++i) name += kLetters[random() % (sizeof kLetters - 1)];
    // Published before it exists, so that no signal can leave it behind.
    slot.Publish(nullptr);
    *temporary = std::move(name);
    slot.Publish(temporary->c_str());
    FileDescriptor file(
        ::open(temporary->c_str(), O_WRONLY | O_CREAT | O_EXCL | O_NOCTTY | O_CLOEXEC, mode));
    if (file.valid()) return file;
    slot.Publish(nullptr);
    if (errno != EEXIST) return file;
  }
  errno = EEXIST;
  return FileDescriptor(-1);
}

}  // namespace

bool FinalTarget(const std::string& path, std::string* target) {
  *target = path;
  // The kernel's own limit on the links of one path.
  for (int links = 0; links < 40; ++links) {
    struct stat status;
    if (::lstat(target->c_str(), &status) != 0 || !S_ISLNK(status.st_mode)) return true;
    std::string text(256, '\0');
    for (;;) {
      const ssize_t length = ::readlink(target->c_str(), text.data(), text.size());
      if (length < 0) return false;
      if (static_cast<size_t>(length) < text.size()) {
        text.resize(static_cast<size_t>(length));
        break;
      }
      text.resize(text.size() * 2);
    }
    // A relative link is read from the directory that holds it.
    *target = !text.empty() && text[0] == '/' ? text : DirectoryOf(*target) + text;
  }
  errno = ELOOP;
  return false;
}

void NameTemporaryFilesAfter(std::string_view program) {
  std::string prefix(".");
  prefix.append(program).append(".");
  TemporaryPrefix() = std::move(prefix);
}

bool WriteFileAtomically(const std::string& path, std::string_view bytes, bool* opened,
                         std::string* err) {
  bool opened_here = false;
  if (opened == nullptr) opened = &opened_here;
  struct stat status;
  const bool exists = ::stat(path.c_str(), &status) == 0;
  if (exists && !S_ISREG(status.st_mode)) return WriteFileInPlace(path, bytes, opened, err);
  // Through symbolic links, the file they lead to is replaced and the links
  // stay. A link whose text leads elsewhere than the kernel's walk (those of
  // /proc) is written through.
  std::string target;
  if (!FinalTarget(path, &target)) {
    *opened = false;
    return Fail(err, errno);
  }
  struct stat target_status;
  if (exists && (::stat(target.c_str(), &target_status) != 0 ||
                 target_status.st_dev != status.st_dev || target_status.st_ino != status.st_ino)) {
    return WriteFileInPlace(path, bytes, opened, err);
  }

  TemporarySlot slot;
  std::string temporary;
  FileDescriptor file = CreateTemporary(target, 0644, slot, &temporary);
  *opened = file.valid();
  if (!file.valid()) return Fail(err, errno);
  // A replaced file keeps its mode; the mode is a courtesy, so a file system
  // that refuses it does not fail the write.
  if (exists) (void)::fchmod(file.get(), status.st_mode & 07777);
  int error = 0;
  if (!WriteAll(file.get(), bytes)) error = errno;
  if (!file.Close() && error == 0) error = errno;
  if (error == 0 && ::rename(temporary.c_str(), target.c_str()) != 0) error = errno;
  if (error != 0) ::unlink(temporary.c_str());
  slot.Publish(nullptr);
  return error == 0 || Fail(err, error);
}

void RemoveTemporaryFilesOnInterrupt() {
  struct sigaction action = {};
  action.sa_handler = EndInterruptedRun;
  action.sa_flags = SA_RESETHAND;
  sigemptyset(&action.sa_mask);
  sigaddset(&action.sa_mask, SIGINT);
  sigaddset(&action.sa_mask, SIGTERM);
  for (int signal_number : {SIGINT, SIGTERM}) {
    // A run started with the signal ignored (a background job, nohup) keeps
    // ignoring it.
    struct sigaction current;
    if (::sigaction(signal_number, nullptr, &current) == 0 && current.sa_handler == SIG_IGN) {
      continue;
    }
    ::sigaction(signal_number, &action, nullptr);
  }
  // A write past the file size limit then fails with EFBIG, like any other
  // failed write, instead of ending the run.
  std::signal(SIGXFSZ, SIG_IGN);
}

// Opened without blocking: a named pipe that no process reads would hold the
// run forever, and fails with ENXIO instead. Writes then block as usual.
bool WriteFileInPlace(const std::string& path, std::string_view bytes, bool* opened,
                      std::string* err) {
  FileDescriptor file(
      ::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_NONBLOCK | O_NOCTTY | O_CLOEXEC, 0666));
  *opened = file.valid();
  if (!file.valid()) {
    const int error = errno;
    struct stat status;
    if (error != ENXIO || ::stat(path.c_str(), &status) != 0 || !S_ISFIFO(status.st_mode)) {
      return Fail(err, error);
    }
    *err = "No process is reading the pipe";
    return false;
  }
  const int flags = ::fcntl(file.get(), F_GETFL);
  if (flags < 0 || ::fcntl(file.get(), F_SETFL, flags & ~O_NONBLOCK) != 0) return Fail(err, errno);
  if (!WriteAll(file.get(), bytes)) return Fail(err, errno);
  if (!file.Close()) return Fail(err, errno);
  return true;
}

}  // namespace zor2
