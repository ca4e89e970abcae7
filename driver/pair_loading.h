#pragma once

#include <cstdint>
#include <deque>
#include <memory>
#include <string>
#include <vector>

#include "documents/type_name_normalization.h"
#include "platform/tools/executor.h"
#include "platform/xml/document.h"
#include "platform/xml/read_error.h"

namespace zor2 {

// Reading the documents of a pair and preparing them for the rules. Each
// document is read and prepared as a task of its own on the run's executor;
// nothing here writes to a log, so that the caller reports faults in its own
// fixed order.

// A document read and prepared, or the reason why it could not be read.
struct LoadedDocument {
  std::string path;
  std::unique_ptr<xml::Document> document;  // null when it could not be read
  xml::ReadError error;                     // why, when document is null
  // When asked for, the text of the values whose type names preparation
  // respelled; the others read as the document wrote them.
  xml::OriginalValues originals{MayNormalizeTypeNames, MayHoldNormalizedTypeNames};
};

// The two documents of a pair.
struct LoadedPair {
  LoadedDocument reference;
  LoadedDocument checked;
  uintmax_t bytes = 0;  // of both files when they were listed
};

// Reads the document at `path` and prepares every attribute value of it,
// keeping the original text of the values it changes when `keep_originals` is
// set; `memory_limit` is xml::MemoryLimit(), measured once per run. A
// document that cannot be read comes back without document.
LoadedDocument LoadDocument(const std::string& path, bool keep_originals, uintmax_t memory_limit);

// The document pairs of a run, loaded in order, the next ones ahead while the
// caller compares the current one: with small pairs, comparing one pair on one
// core would leave the other cores idle. Pairs are read ahead only up to
// kPairsAhead of them and kReadAheadBytes of files; a large pair keeps every
// core busy on its own (its two documents, then CompareFrameworks) and is read
// when its turn comes, so that large documents are held one pair at a time.
//
// Thread safety: used by one thread; the loads run as tasks of `executor`.
class PairReader {
 public:
  struct Paths {
    std::string reference;
    std::string checked;
    uintmax_t bytes = 0;  // of both files when they were listed
  };
  static constexpr size_t kPairsAhead = 8;
  static constexpr uintmax_t kReadAheadBytes = uintmax_t{16} << 20;

  // REQUIRES: `executor` outlives the reader.
  PairReader(std::vector<Paths> pairs, bool keep_originals, Executor& executor);
  PairReader(const PairReader&) = delete;
  PairReader& operator=(const PairReader&) = delete;

  bool HasNext() const { return taken_ < pairs_.size(); }
  // The next pair, once loaded; the pairs after it are read ahead meanwhile.
  // REQUIRES: HasNext().
  LoadedPair Next();

 private:
  struct Loading {
    Executor::Handle<LoadedDocument> reference;
    Executor::Handle<LoadedDocument> checked;
    uintmax_t bytes;
  };
  void Start();

  std::vector<Paths> pairs_;
  bool keep_originals_;
  Executor& executor_;
  uintmax_t memory_limit_;
  size_t taken_ = 0;    // pairs handed out
  size_t started_ = 0;  // pairs whose loading has started
  std::deque<Loading> ahead_;
  uintmax_t bytes_ahead_ = 0;
};

// The pair of documents `reference` and `checked`, for a PairReader; the size
// of a file that cannot be measured counts for nothing (its load will say why).
PairReader::Paths DocumentPair(std::string reference, std::string checked);

// Appends the pairs of a directory run to `pairs`: each regular file of
// `reference_dir` and whatever stands under its name in `checked_dir` (a
// dangling link or a directory too, which then fails to load), in the order
// of the listing; the names of those without anything there go to `missing`
// unless it is null. False with the system's reason in `err` when `reference_dir` cannot be
// listed.
bool ListDocumentPairs(const std::string& reference_dir, const std::string& checked_dir,
                       std::vector<PairReader::Paths>* pairs, std::vector<std::string>* missing,
                       std::string* err);

}  // namespace zor2
