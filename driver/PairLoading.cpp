#include "driver/PairLoading.h"

#include <filesystem>
#include <system_error>
#include <utility>

#include "documents/TypeNameNormalization.h"
#include "platform/tools/XMLString.h"

namespace {

// Touches nothing but its own document, so that loads can run at once.
LoadedDocument LoadDocument(const TAFileName& path) {
  LoadedDocument document{path, nullptr, {}};
  document.root = QEXVBTXMLNode::CreateFromFile(path.c_str(), document.error);
  if (document.root != nullptr) changeAttributeValues(document.root.get(), PrepareValue);
  return document;
}

// Runs `task` on a thread of its own, or, should no thread be available, when
// its result is asked for.
template <typename Task>
auto Launch(Task task) {
  try {
    return std::async(std::launch::async, task);
  } catch (const std::system_error&) {
    return std::async(std::launch::deferred, std::move(task));
  }
}

// The size of the two files of a pair; a file that cannot be measured counts
// for nothing (its load will say why).
uintmax_t PairBytes(const std::pair<TAFileName, TAFileName>& paths) {
  std::error_code error;
  uintmax_t bytes = 0;
  for (const TAFileName* path : {&paths.first, &paths.second}) {
    const uintmax_t size = std::filesystem::file_size(path->str(), error);
    if (!error) bytes += size;
  }
  return bytes;
}

}  // namespace

// Both steps in one pass give each value what one pass over the document per
// step would give it, at half the walks.
int PrepareValue(std::string_view value, std::string& rewritten) {
  std::string normalized;
  if (NormalizeTypeNames(value, normalized) == 0) return decodeXMLString(value, rewritten);
  if (decodeXMLString(normalized, rewritten) == 0) rewritten = std::move(normalized);
  return 1;
}

LoadedPair LoadPair(const TAFileName& reference, const TAFileName& checked) {
  std::future<LoadedDocument> checkedLoad = Launch([checked] { return LoadDocument(checked); });
  LoadedDocument referenceDocument = LoadDocument(reference);
  return {std::move(referenceDocument), checkedLoad.get()};
}

LoadedPair PairReader::Next() {
  if (ahead_.empty()) Start();
  Loading loading = std::move(ahead_.front());
  ahead_.pop_front();
  bytesAhead_ -= loading.bytes;
  ++taken_;
  LoadedPair pair = loading.pair.get();
  while (started_ < pairs_.size() && ahead_.size() < kPairsAhead &&
         bytesAhead_ + PairBytes(pairs_[started_]) <= kReadAheadBytes) {
    Start();
  }
  return pair;
}

void PairReader::Start() {
  const Paths& paths = pairs_[started_++];
  const uintmax_t bytes = PairBytes(paths);
  ahead_.push_back({StartLoadingPair(paths.first, paths.second), bytes});
  bytesAhead_ += bytes;
}

std::future<LoadedPair> StartLoadingPair(const TAFileName& reference, const TAFileName& checked) {
  // The paths are copied into the task, which may outlive the caller's.
  return Launch([reference, checked] { return LoadPair(reference, checked); });
}
