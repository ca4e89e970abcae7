#include "driver/pair_loading.h"

#include <sys/stat.h>

#include <cerrno>
#include <new>
#include <optional>

#include "documents/value_preparation.h"
#include "platform/tools/paths.h"
#include "platform/xml/reader.h"

namespace zor2 {
namespace {

// The size of the regular file at `path`, or nothing when it is none.
std::optional<uintmax_t> RegularFileSize(const std::string& path) {
  struct stat status;
  if (::stat(path.c_str(), &status) != 0 || !S_ISREG(status.st_mode)) return std::nullopt;
  return static_cast<uintmax_t>(status.st_size);
}

// Something stands at `path`, a link that leads nowhere included; a path that
// cannot be looked at counts as there, so that its load names the reason.
bool Exists(const std::string& path) {
  struct stat status;
  return ::lstat(path.c_str(), &status) == 0 || (errno != ENOENT && errno != ENOTDIR);
}

}  // namespace

// Touches nothing but its own document, so that loads can run at once. A
// document that does not fit in memory is a fault of its pair only.
LoadedDocument LoadDocument(const std::string& path, bool keep_originals, uintmax_t memory_limit) {
  LoadedDocument loaded{
      path, nullptr, {}, xml::OriginalValues(MayNormalizeTypeNames, MayHoldNormalizedTypeNames)};
  try {
    // Values are prepared as the document is read.
    const xml::ReadPreparation preparation{PrepareValue,
                                           keep_originals ? &loaded.originals : nullptr};
    xml::ReadDocumentFile(path, memory_limit, preparation, &loaded.document, &loaded.error);
  } catch (const std::bad_alloc&) {
    loaded.document.reset();
    loaded.error = xml::ReadError{xml::kNotEnoughMemory, 0, 0};
  }
  return loaded;
}

PairReader::Paths DocumentPair(std::string reference, std::string checked) {
  const uintmax_t bytes =
      RegularFileSize(reference).value_or(0) + RegularFileSize(checked).value_or(0);
  return {std::move(reference), std::move(checked), bytes};
}

bool ListDocumentPairs(const std::string& reference_dir, const std::string& checked_dir,
                       std::vector<PairReader::Paths>* pairs, std::vector<std::string>* missing,
                       std::string* err) {
  std::vector<std::string> entries;
  if (!ListRegularFiles(reference_dir, &entries, err)) return false;
  for (std::string& entry : entries) {
    std::string name = BaseName(entry);
    std::string checked = JoinPath(checked_dir, name);
    // Each file's status is taken once here; the loads look again only at
    // what they open.
    if (const std::optional<uintmax_t> checked_bytes = RegularFileSize(checked)) {
      const uintmax_t bytes = RegularFileSize(entry).value_or(0) + *checked_bytes;
      pairs->push_back({std::move(entry), std::move(checked), bytes});
    } else if (Exists(checked)) {
      // Whatever else stands under the name (a dangling link, a directory, a
      // pipe) is the counterpart, which then fails to load and says why.
      const uintmax_t bytes = RegularFileSize(entry).value_or(0);
      pairs->push_back({std::move(entry), std::move(checked), bytes});
    } else if (missing != nullptr) {
      missing->push_back(std::move(name));
    }
  }
  return true;
}

PairReader::PairReader(std::vector<Paths> pairs, bool keep_originals, Executor& executor)
    : pairs_(std::move(pairs)),
      keep_originals_(keep_originals),
      executor_(executor),
      memory_limit_(xml::MemoryLimit()) {}

LoadedPair PairReader::Next() {
  if (ahead_.empty()) Start();
  Loading loading = std::move(ahead_.front());
  ahead_.pop_front();
  bytes_ahead_ -= loading.bytes;
  ++taken_;
  // The next pairs are handed over before this one is waited for, so that
  // the workers go on with them while this thread takes its own loads in
  // hand when no worker has yet.
  while (started_ < pairs_.size() && ahead_.size() < kPairsAhead &&
         bytes_ahead_ + pairs_[started_].bytes <= kReadAheadBytes) {
    Start();
  }
  LoadedDocument reference = loading.reference.Get();
  return {std::move(reference), loading.checked.Get(), loading.bytes};
}

void PairReader::Start() {
  const Paths& paths = pairs_[started_++];
  // The tasks hold copies of what they need: they may outlive this reader.
  auto load = [keep_originals = keep_originals_, memory_limit = memory_limit_](std::string path) {
    return [path = std::move(path), keep_originals, memory_limit] {
      return LoadDocument(path, keep_originals, memory_limit);
    };
  };
  ahead_.push_back({executor_.Submit(load(paths.reference)), executor_.Submit(load(paths.checked)),
                    paths.bytes});
  bytes_ahead_ += paths.bytes;
}

}  // namespace zor2
