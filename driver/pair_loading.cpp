#include "driver/pair_loading.h"

#include <sys/stat.h>

#include <cerrno>
#include <filesystem>
#include <new>
#include <system_error>

#include "documents/type_name_normalization.h"
#include "platform/tools/background.h"
#include "platform/tools/paths.h"
#include "platform/tools/xml_escaping.h"
#include "platform/xml/reader.h"

namespace zor2 {
namespace {

// Something stands at `path`, a link that leads nowhere included; a path that
// cannot be looked at counts as there, so that its load names the reason.
bool Exists(const std::string& path) {
  struct stat status;
  return ::lstat(path.c_str(), &status) == 0 || (errno != ENOENT && errno != ENOTDIR);
}

// Touches nothing but its own document, so that loads can run at once. A
// document that does not fit in memory is a fault of its pair only.
LoadedDocument LoadDocument(const std::string& path, bool keep_originals) {
  LoadedDocument loaded{
      path, nullptr, {}, xml::OriginalValues(MayNormalizeTypeNames, MayHoldNormalizedTypeNames)};
  try {
    if (xml::ReadDocumentFile(path, &loaded.document, &loaded.error)) {
      loaded.document->RewriteValues(PrepareValue, keep_originals ? &loaded.originals : nullptr);
    }
  } catch (const std::bad_alloc&) {
    loaded.document.reset();
    loaded.error = xml::ReadError{xml::kNotEnoughMemory, 0, 0};
  }
  return loaded;
}

// The size of the two files of a pair; a file that cannot be measured counts
// for nothing (its load will say why).
uintmax_t PairBytes(const PairReader::Paths& paths) {
  std::error_code error;
  uintmax_t bytes = 0;
  for (const std::string* path : {&paths.reference, &paths.checked}) {
    const uintmax_t size = std::filesystem::file_size(*path, error);
    if (!error) bytes += size;
  }
  return bytes;
}

}  // namespace

// Both steps in one pass give each value what one pass over the document per
// step would give it, at half the walks.
bool PrepareValue(std::string_view value, std::string* rewritten) {
  std::string normalized;
  if (!NormalizeTypeNames(value, &normalized)) return DecodeXmlReferences(value, rewritten);
  if (!DecodeXmlReferences(normalized, rewritten)) *rewritten = std::move(normalized);
  return true;
}

bool ListDocumentPairs(const std::string& reference_dir, const std::string& checked_dir,
                       std::vector<PairReader::Paths>* pairs, std::vector<std::string>* missing,
                       std::string* err) {
  std::vector<std::string> entries;
  if (!ListRegularFiles(reference_dir, &entries, err)) return false;
  for (std::string& entry : entries) {
    std::string name = BaseName(entry);
    std::string checked = JoinPath(checked_dir, name);
    // Whatever stands under the name (a dangling link, a directory, a pipe)
    // is the counterpart, which then fails to load and says why.
    if (Exists(checked)) {
      pairs->push_back({std::move(entry), std::move(checked)});
    } else if (missing != nullptr) {
      missing->push_back(std::move(name));
    }
  }
  return true;
}

LoadedPair LoadPair(const std::string& reference, const std::string& checked, bool keep_originals) {
  std::future<LoadedDocument> checked_load =
      RunInBackground([checked, keep_originals] { return LoadDocument(checked, keep_originals); });
  LoadedDocument reference_document = LoadDocument(reference, keep_originals);
  return {std::move(reference_document), checked_load.get()};
}

LoadedPair PairReader::Next() {
  if (ahead_.empty()) Start();
  Loading loading = std::move(ahead_.front());
  ahead_.pop_front();
  bytes_ahead_ -= loading.bytes;
  ++taken_;
  LoadedPair pair = loading.pair.get();
  while (started_ < pairs_.size() && ahead_.size() < kPairsAhead &&
         bytes_ahead_ + PairBytes(pairs_[started_]) <= kReadAheadBytes) {
    Start();
  }
  return pair;
}

void PairReader::Start() {
  const Paths& paths = pairs_[started_++];
  const uintmax_t bytes = PairBytes(paths);
  // The paths are copied into the task, which may outlive this reader's.
  const bool keep_originals = keep_originals_;
  ahead_.push_back({RunInBackground([paths, keep_originals] {
                      return LoadPair(paths.reference, paths.checked, keep_originals);
                    }),
                    bytes});
  bytes_ahead_ += bytes;
}

}  // namespace zor2
