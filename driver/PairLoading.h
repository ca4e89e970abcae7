#pragma once

#include <cstdint>
#include <deque>
#include <future>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/tools/TAFileName.h"
#include "platform/xml/QEXVBTXMLNode.h"

// Reading the documents of a pair and preparing them for the rules. The two
// documents of a pair are independent, so each is read on a thread of its
// own; nothing here writes to the log streams, so that the caller reports
// faults in its own fixed order.

// A document read and prepared, or the reason why it could not be read.
struct LoadedDocument {
  TAFileName path;
  std::unique_ptr<QEXVBTXMLNode> root;  // null when the document could not be read
  XMLReadError error;                   // why, when root is null
};

// The two documents of a pair.
struct LoadedPair {
  LoadedDocument reference;
  LoadedDocument checked;
};

// Prepares one attribute value of an input document for the rules, following
// the rewrite contract of changeAttributeValues: type names are normalised
// (NormalizeTypeNames) before entity references are decoded
// (decodeXMLString), so that the normalisation only ever sees the text as
// written in the document.
int PrepareValue(std::string_view value, std::string& rewritten);

// Reads the documents at `reference` and `checked`, each on its own thread,
// and rewrites all attribute values of each with PrepareValue. Returns when
// both are done; a document that cannot be read comes back without root.
LoadedPair LoadPair(const TAFileName& reference, const TAFileName& checked);

// LoadPair started in the background.
std::future<LoadedPair> StartLoadingPair(const TAFileName& reference, const TAFileName& checked);

// The document pairs of a run, loaded in order, the next ones ahead while the
// caller compares the current one: with small pairs, comparing one pair on
// one core would leave the other core idle. Pairs are read ahead only up to
// kPairsAhead of them and kReadAheadBytes of files; a large pair keeps both
// cores busy on its own (LoadPair, CompareFrameworks) and is read when its
// turn comes, so that large documents are held one pair at a time.
class PairReader {
 public:
  using Paths = std::pair<TAFileName, TAFileName>;  // reference, checked
  static constexpr size_t kPairsAhead = 2;
  static constexpr uintmax_t kReadAheadBytes = uintmax_t{16} << 20;

  explicit PairReader(std::vector<Paths> pairs) : pairs_(std::move(pairs)) {}
  PairReader(const PairReader&) = delete;
  PairReader& operator=(const PairReader&) = delete;

  bool HasNext() const { return taken_ < pairs_.size(); }
  // The next pair, once loaded (HasNext() must be true); the pairs after it
  // are then read ahead.
  LoadedPair Next();

 private:
  struct Loading {
    std::future<LoadedPair> pair;
    uintmax_t bytes;
  };
  void Start();

  std::vector<Paths> pairs_;
  size_t taken_ = 0;    // pairs handed out
  size_t started_ = 0;  // pairs whose loading has started
  std::deque<Loading> ahead_;
  uintmax_t bytesAhead_ = 0;
};
