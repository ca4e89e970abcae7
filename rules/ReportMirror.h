#pragma once

#include <array>
#include <cstddef>
#include <memory>

#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/MethodRecords.h"
#include "rules/ZOR2Error.h"

// The mirror, in the report, of a reference element that a walk compares.
// The report element is created only when a finding is recorded under it or
// under one of its mirrored descendants, and its ancestors that are still
// pending are created first. The walks run depth first, so elements are
// appended in the order in which eager mirroring would have appended them,
// and the report holds exactly the branches with findings that pruning would
// have left: a comparison without findings costs no report element at all.
class ReportMirror {
 public:
  // An existing report element, such as the report root; null for a walk
  // without a report, under which nothing is ever created.
  explicit ReportMirror(QEXVBTXMLNode* element) : element_(element) {}
  // A pending element `tag` (a literal) to go under `parent`, which must
  // outlive this mirror.
  ReportMirror(ReportMirror& parent, const char* tag) : parent_(&parent), tag_(tag) {}
  // A pending element `tag` that is created into `*holder` instead of under a
  // parent, for the caller to hand to the report later; with a null `holder`
  // nothing is ever created. `holder` must outlive this mirror.
  ReportMirror(std::unique_ptr<QEXVBTXMLNode>* holder, const char* tag)
      : holder_(holder), tag_(tag) {}
  ReportMirror(const ReportMirror&) = delete;
  ReportMirror& operator=(const ReportMirror&) = delete;

  // Gives the element attribute `name` with a copy of `value`; does nothing
  // when `value` is null, so an absent attribute stays absent. Until the
  // element is created both strings are only pointed to, so they must stay
  // valid until the next Element() (document values and literals do). A
  // pending element takes at most four attributes (a "File" has the most).
  void CopyAttribute(const char* name, const char* value);

  // The report element, created now with its pending ancestors if it does
  // not exist yet; null for a walk without a report.
  QEXVBTXMLNode* Element();

 private:
  struct Attribute {
    const char* name;
    const char* value;
  };
  static constexpr size_t kMaxPendingAttributes = 4;

  ReportMirror* parent_ = nullptr;
  std::unique_ptr<QEXVBTXMLNode>* holder_ = nullptr;
  const char* tag_ = nullptr;
  QEXVBTXMLNode* element_ = nullptr;
  std::array<Attribute, kMaxPendingAttributes> attributes_{};
  size_t attributeCount_ = 0;
};

// Records a finding under `parent`, created first if it is pending: AddError
// on its report element. Returns the new error, or null without a report.
ZOR2Error* AddError(ReportMirror& parent, const char* code);

// Gives a "Method" mirror the "Name" and then the "Signature" of `method`.
void MirrorMethod(ReportMirror& reportMethod, const MethodInfo& method);
