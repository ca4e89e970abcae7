#pragma once

#include <cstdint>
#include <deque>
#include <future>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "documents/type_name_normalization.h"
#include "platform/xml/document.h"
#include "platform/xml/read_error.h"

namespace zor2 {

// Reading the documents of a pair and preparing them for the rules. The two
// documents of a pair are independent, so each is read on a thread of its
// own; nothing here writes to a log, so that the caller reports faults in its
// own fixed order.

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
};

// Prepares one attribute value of an input document for the rules, as a value
// rewrite (xml::ValueRewrite): type names are normalised before entity
// references are decoded, so that the normalisation only ever sees the text
// as written in the document.
bool PrepareValue(std::string_view value, std::string* rewritten);

// Reads the documents at `reference` and `checked`, each on its own thread,
// and prepares every attribute value of each, keeping the original text of
// the values it changes when `keep_originals` is set. Returns when both are
// done; a document that cannot be read comes back without document.
LoadedPair LoadPair(const std::string& reference, const std::string& checked, bool keep_originals);

// The document pairs of a run, loaded in order, the next ones ahead while the
// caller compares the current one: with small pairs, comparing one pair on one
// core would leave the other core idle. Pairs are read ahead only up to
// kPairsAhead of them and kReadAheadBytes of files; a large pair keeps both
// cores busy on its own (LoadPair, CompareFrameworks) and is read when its
// turn comes, so that large documents are held one pair at a time.
//
// Thread safety: used by one thread; the loading runs on threads of its own.
class PairReader {
 public:
  struct Paths {
    std::string reference;
    std::string checked;
  };
  static constexpr size_t kPairsAhead = 2;
  static constexpr uintmax_t kReadAheadBytes = uintmax_t{16} << 20;

  PairReader(std::vector<Paths> pairs, bool keep_originals)
      : pairs_(std::move(pairs)), keep_originals_(keep_originals) {}
  PairReader(const PairReader&) = delete;
  PairReader& operator=(const PairReader&) = delete;

  bool HasNext() const { return taken_ < pairs_.size(); }
  // The next pair, once loaded; the pairs after it are then read ahead.
  // REQUIRES: HasNext().
  LoadedPair Next();

 private:
  struct Loading {
    std::future<LoadedPair> pair;
    uintmax_t bytes;
  };
  void Start();

  std::vector<Paths> pairs_;
  bool keep_originals_;
  size_t taken_ = 0;    // pairs handed out
  size_t started_ = 0;  // pairs whose loading has started
  std::deque<Loading> ahead_;
  uintmax_t bytes_ahead_ = 0;
};

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
