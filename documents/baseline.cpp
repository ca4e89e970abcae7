#include "documents/baseline.h"

#include <cstring>
#include <memory>
#include <string_view>

#include "platform/tools/xml_escaping.h"
#include "platform/xml/reader.h"

namespace zor2 {
namespace {

// The value of attribute `name` of `element` as the report meant it (its
// references decoded), and whether it is there.
bool ValueOf(const xml::Element& element, const char* name, std::string* value) {
  const char* raw = element.FindAttribute(name);
  if (raw == nullptr) return false;
  if (!DecodeXmlReferences(raw, value)) *value = raw;
  return true;
}

bool IsLocationTag(std::string_view tag) {
  return tag == "Framework" || tag == "Interfaces" || tag == "File" || tag == "Class" ||
         tag == "Method" || tag == "Arg" || tag == "Document";
}

}  // namespace

bool Baseline::Read(const std::string& path, xml::ReadError* err) {
  std::unique_ptr<xml::Document> document;
  if (!xml::ReadDocumentFile(path, &document, err)) return false;
  const xml::Element& root = document->root();
  if (std::strcmp(root.tag(), "XmlDiff") != 0) {
    err->reason = "not a report of zor2check: its root element is <" + std::string(root.tag()) +
                  ">, not <XmlDiff>";
    return false;
  }
  // Depth first, without recursion: `open` holds the elements whose children
  // are being visited, each with the report path up to it.
  struct Open {
    const xml::Element* next_child;
    std::string path;
  };
  std::vector<Open> open = {{root.first_child(), ""}};
  while (!open.empty()) {
    const xml::Element* element = open.back().next_child;
    if (element == nullptr) {
      open.pop_back();
      continue;
    }
    open.back().next_child = element->next_sibling();
    const std::string_view tag = element->tag();
    std::string step_path = open.back().path;
    if (tag == "Error") {
      std::string id;
      if (!ValueOf(*element, "ID", &id)) continue;
      Entry entry;
      entry.has_reason = ValueOf(*element, "Reason", &entry.reason);
      step_path += id;
      if (entries_.emplace(step_path, entry).second) order_.push_back(step_path);
      continue;
    }
    if (IsLocationTag(tag)) {
      std::string name;
      std::string signature;
      const bool has_name = ValueOf(*element, "Name", &name);
      const bool has_signature = ValueOf(*element, "Signature", &signature);
      step_path += ReportStep(tag, has_name ? name.c_str() : nullptr,
                              has_signature ? signature.c_str() : nullptr);
    }
    open.push_back({element->first_child(), std::move(step_path)});
  }
  return true;
}

void Baseline::Accept(std::vector<Finding>* findings) {
  for (Finding& finding : *findings) {
    auto entry = entries_.find(finding.report_path);
    if (entry == entries_.end()) continue;
    entry->second.matched = true;
    finding.accepted = true;
    finding.reason = entry->second.reason;
    finding.report_error->SetAttribute("Accepted", "Y");
    if (entry->second.has_reason) finding.report_error->SetAttribute("Reason", finding.reason);
  }
}

void Baseline::Accept(std::string_view tag, Absence* absence) {
  auto entry = entries_.find(ReportStep(tag, absence->name.c_str(), nullptr) + kNoCounterpart);
  if (entry == entries_.end()) return;
  entry->second.matched = true;
  absence->accepted = true;
  absence->reason = entry->second.reason;
}

std::vector<std::string> Baseline::StaleEntries() const {
  std::vector<std::string> stale;
  for (const std::string& path : order_) {
    if (!entries_.at(path).matched) stale.push_back(ReadablePath(path));
  }
  return stale;
}

std::string ReadablePath(const std::string& report_path) {
  std::string readable;
  size_t start = 0;
  for (size_t end; (end = report_path.find('\x1e', start)) != std::string::npos; start = end + 1) {
    std::string step = report_path.substr(start, end - start);
    size_t tag_end = step.find('\x1f');
    std::string text = step.substr(0, tag_end) + " " + step.substr(tag_end + 1);
    // A method's signature says more than its name.
    size_t signature = text.find('\x1f');
    if (signature != std::string::npos) {
      text = step.substr(0, tag_end) + " " + text.substr(signature + 1);
    }
    readable += text + " / ";
  }
  if (readable.size() >= 3) readable.resize(readable.size() - 3);
  return readable + ": " + report_path.substr(start);
}

}  // namespace zor2
