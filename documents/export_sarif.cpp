#include "documents/export_sarif.h"

#include <cctype>
#include <cstdint>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

#include "documents/export_json.h"
#include "documents/export_text.h"
#include "documents/json_writer.h"

namespace zor2 {

namespace {

constexpr std::string_view kSchema =
    "https://docs.oasis-open.org/sarif/sarif/v2.1.0/errata01/os/schemas/sarif-schema-2.1.0.json";

// The rule's name: its full name in upper camel case, letters and digits only
// ("@ZOR2Level Has Changed" is "ZOR2LevelHasChanged").
std::string RuleName(std::string_view full_name) {
  std::string name;
  bool word_start = true;
  for (char c : full_name) {
    if (std::isalnum(static_cast<unsigned char>(c))) {
      name.push_back(word_start ? static_cast<char>(std::toupper(static_cast<unsigned char>(c)))
                                : c);
      word_start = false;
    } else {
      word_start = true;
    }
  }
  return name;
}

// The base that every artifact's URI is relative to: the root of the
// repository, which only the service that reads the log knows.
constexpr std::string_view kSourceRoot = "SRCROOT";

// `folder` and then `file` as one relative URI reference: "/" between the
// segments, no empty, "." or ".." segment (a ".." takes the segment before it
// away, and none before the start), every byte of a segment but the
// unreserved ones percent-encoded, so that a ":" or a blank cannot change its
// meaning.
std::string RelativeUri(std::string_view folder, std::string_view file) {
  static constexpr char kHex[] = "0123456789ABCDEF";
  std::vector<std::string> segments;
  for (std::string_view path : {folder, file}) {
    while (!path.empty()) {
      const size_t slash = path.find('/');
      const std::string_view segment = path.substr(0, slash);
      path = slash == std::string_view::npos ? std::string_view() : path.substr(slash + 1);
      if (segment.empty() || segment == ".") continue;
      if (segment == "..") {
        if (!segments.empty()) segments.pop_back();
        continue;
      }
      std::string encoded;
      for (char c : segment) {
        const auto byte = static_cast<unsigned char>(c);
        if (std::isalnum(byte) || c == '-' || c == '.' || c == '_' || c == '~') {
          encoded.push_back(c);
        } else {
          encoded.push_back('%');
          encoded.push_back(kHex[byte >> 4]);
          encoded.push_back(kHex[byte & 0xF]);
        }
      }
      segments.push_back(std::move(encoded));
    }
  }
  std::string uri;
  for (const std::string& segment : segments) {
    if (!uri.empty()) uri += '/';
    uri += segment;
  }
  return uri;
}

// The chain of names that places a finding, each name ended by a separator
// that no name holds.
std::string ChainKey(const Finding& finding) {
  std::string key;
  for (std::string_view part :
       {std::string_view(MessageTypeOf(finding.code).id), std::string_view(finding.framework),
        std::string_view(finding.group), std::string_view(finding.file),
        std::string_view(finding.class_name),
        std::string_view(finding.signature.empty() ? finding.method : finding.signature),
        std::string_view(finding.argument)}) {
    key += part;
    key += '\0';
  }
  return key;
}

// 64-bit FNV-1a: the same on every platform and in every run.
uint64_t Fnv1a(std::string_view bytes) {
  uint64_t hash = 0xcbf29ce484222325ULL;
  for (char c : bytes) {
    hash ^= static_cast<unsigned char>(c);
    hash *= 0x100000001b3ULL;
  }
  return hash;
}

// The fingerprint of the finding whose chain key is `key`: its hash in 16
// hexadecimal digits, and ":" and the rank for the second and later findings
// with that key.
std::string Fingerprint(std::string_view key, int occurrence) {
  static constexpr char kHex[] = "0123456789abcdef";
  uint64_t hash = Fnv1a(key);
  std::string fingerprint(16, '0');
  for (int i = 15; i >= 0; --i, hash >>= 4) fingerprint[i] = kHex[hash & 0xF];
  if (occurrence > 1) {
    fingerprint += ':';
    fingerprint += std::to_string(occurrence);
  }
  return fingerprint;
}

std::string LogicalName(const Finding& finding) {
  if (!finding.argument.empty()) return finding.argument;
  if (!finding.method.empty()) return finding.method;
  if (!finding.class_name.empty()) return finding.class_name;
  return finding.framework;
}

std::string LogicalKind(const Finding& finding) {
  if (!finding.argument.empty()) return "parameter";
  if (!finding.method.empty() || !finding.signature.empty()) return "member";
  if (!finding.class_name.empty()) return "type";
  return "module";
}

std::string FullyQualifiedName(const Finding& finding) {
  std::string name = finding.framework;
  for (const std::string* part : {&finding.class_name, &finding.method, &finding.argument}) {
    if (part->empty()) continue;
    name += '/';
    name += *part;
  }
  return name;
}

std::string MessageText(const Finding& finding) {
  std::string text(MessageTypeOf(finding.code).full_name);
  text += ": ";
  text += finding.file;
  const std::string place = PlaceInFile(finding);
  if (!place.empty()) text += ", " + place;
  text += '.';
  if (!finding.reference_value.empty() || !finding.checked_value.empty()) {
    text += "\nReference: ";
    text += finding.reference_value.empty() ? "(none)" : finding.reference_value;
    text += "\nChecked: ";
    text += finding.checked_value.empty() ? "(none)" : finding.checked_value;
    if (finding.more_replacements > 0) {
      text += "\n(and " + std::to_string(finding.more_replacements) + " more)";
    }
  }
  return text;
}

void WriteRules(JsonWriter& json) {
  json.BeginArray();
  for (const MessageType& type : kMessageTypes) {
    const std::string help = HelpAsText(type.help);
    json.BeginObject();
    json.Member("id", type.id);
    json.Member("name", RuleName(type.full_name));
    json.Key("shortDescription");
    json.BeginObject();
    json.Member("text", type.full_name);
    json.EndObject();
    json.Key("fullDescription");
    json.BeginObject();
    json.Member("text", help);
    json.EndObject();
    json.Key("help");
    json.BeginObject();
    json.Member("text", help);
    json.EndObject();
    json.Key("defaultConfiguration");
    json.BeginObject();
    json.Member("level", "error");
    json.EndObject();
    json.EndObject();
  }
  json.EndArray();
}

void WriteLocation(const Finding& finding, std::string_view folder, JsonWriter& json) {
  json.BeginArray();
  json.BeginObject();
  json.Key("physicalLocation");
  json.BeginObject();
  json.Key("artifactLocation");
  json.BeginObject();
  json.Member("uri", RelativeUri(folder, finding.file));
  json.Member("uriBaseId", kSourceRoot);
  json.EndObject();
  if (finding.line > 0) {
    json.Key("region");
    json.BeginObject();
    json.Member("startLine", finding.line);
    json.EndObject();
  }
  json.EndObject();
  json.Key("logicalLocations");
  json.BeginArray();
  json.BeginObject();
  json.Member("name", LogicalName(finding));
  json.Member("fullyQualifiedName", FullyQualifiedName(finding));
  json.Member("kind", LogicalKind(finding));
  json.EndObject();
  json.EndArray();
  json.EndObject();
  json.EndArray();
}

void WriteResult(const Finding& finding, const std::string& fingerprint, std::string_view folder,
                 JsonWriter& json) {
  const MessageType& type = MessageTypeOf(finding.code);
  json.BeginObject();
  json.Member("ruleId", type.id);
  json.Member("ruleIndex", static_cast<int>(finding.code));
  json.Member("level", "error");
  json.Key("message");
  json.BeginObject();
  json.Member("text", MessageText(finding));
  json.EndObject();
  json.Key("locations");
  WriteLocation(finding, folder, json);
  json.Key("partialFingerprints");
  json.BeginObject();
  json.Member("zor2checkFinding/v1", fingerprint);
  json.EndObject();
  if (finding.accepted) {
    json.Key("suppressions");
    json.BeginArray();
    json.BeginObject();
    json.Member("kind", "external");
    json.Member("status", "accepted");
    if (!finding.reason.empty()) json.Member("justification", finding.reason);
    json.EndObject();
    json.EndArray();
  }
  json.Key("properties");
  json.BeginObject();
  json.Member("framework", finding.framework);
  json.Member("group", finding.group);
  json.Member("file", finding.file);
  json.Member("class", finding.class_name);
  json.Member("method", finding.method);
  json.Member("signature", finding.signature);
  json.Member("argument", finding.argument);
  json.Member("referenceValue", finding.reference_value);
  json.Member("checkedValue", finding.checked_value);
  json.Member("moreReplacements", finding.more_replacements);
  json.EndObject();
  json.EndObject();
}

void WriteRunProperties(const RunDescription& run, const RunSummary& summary, JsonWriter& json) {
  json.BeginObject();
  json.Member("reference", run.reference);
  json.Member("checked", run.checked);
  json.Member("report", run.report);
  json.Member("options", run.options);
  json.Member("verdict", VerdictName(VerdictOf(summary)));
  json.Member("findings", TotalFindings(summary));
  json.Member("accepted", summary.accepted);
  json.Member("files", summary.files);
  json.Member("frameworks", summary.frameworks);
  json.Member("pairsCompared", summary.pairs_compared);
  json.Member("pairsSkipped", summary.pairs_skipped);
  json.Member("filesChecked", summary.files_checked);
  json.Member("nothingChecked", summary.nothing_checked);
  std::vector<std::string> missing;
  for (const Absence& absence : summary.missing_documents) missing.push_back(absence.name);
  json.Member("missingCounterparts", missing);
  json.Key("withoutCounterpart");
  WriteAbsences(summary, json);
  json.Member("staleBaselineEntries", summary.stale_baseline_entries);
  json.EndObject();
}

}  // namespace

std::string FindingFingerprint(const Finding& finding, int occurrence) {
  return Fingerprint(ChainKey(finding), occurrence);
}

std::string ExportSarif(const RunDescription& run, const RunSummary& summary,
                        const std::vector<Finding>& findings) {
  std::string out;
  out.reserve(16384 + findings.size() * 1024);
  // Code-scanning services read it, people hardly: compact, as SARIF files
  // of many results usually are.
  JsonWriter json(&out, JsonWriter::Layout::kCompact);
  json.BeginObject();
  json.Member("$schema", kSchema);
  json.Member("version", "2.1.0");
  json.Key("runs");
  json.BeginArray();
  json.BeginObject();
  json.Key("tool");
  json.BeginObject();
  json.Key("driver");
  json.BeginObject();
  json.Member("name", "zor2check");
  json.Member("version", run.tool_version);
  json.Key("rules");
  WriteRules(json);
  json.EndObject();
  json.EndObject();
  json.Key("originalUriBaseIds");
  json.BeginObject();
  json.Key(kSourceRoot);
  json.BeginObject();
  json.Key("description");
  json.BeginObject();
  json.Member("text", "The root of the repository, which every artifact's URI is relative to");
  json.EndObject();
  json.EndObject();
  json.EndObject();
  json.Key("invocations");
  json.BeginArray();
  json.BeginObject();
  // Whatever the run could not do makes the run unsuccessful, so that no
  // service takes its results for a complete check.
  json.Member("executionSuccessful", summary.failures.empty());
  if (!summary.failures.empty()) {
    json.Key("toolExecutionNotifications");
    json.BeginArray();
    for (const RunFailure& failure : summary.failures) {
      json.BeginObject();
      json.Member("level", "error");
      json.Key("message");
      json.BeginObject();
      json.Member("text", failure.path + ": " + failure.reason);
      json.EndObject();
      json.Key("properties");
      json.BeginObject();
      json.Member("path", failure.path);
      json.Member("reason", failure.reason);
      json.EndObject();
      json.EndObject();
    }
    json.EndArray();
  }
  json.EndObject();
  json.EndArray();
  json.Key("results");
  json.BeginArray();
  std::unordered_map<std::string, int> seen;
  seen.reserve(findings.size());
  for (const Finding& finding : findings) {
    std::string key = ChainKey(finding);
    const int occurrence = ++seen[key];
    WriteResult(finding, Fingerprint(key, occurrence), run.sarif_base, json);
  }
  json.EndArray();
  json.Key("properties");
  WriteRunProperties(run, summary, json);
  json.EndObject();
  json.EndArray();
  json.EndObject();
  out.push_back('\n');
  return out;
}

}  // namespace zor2
