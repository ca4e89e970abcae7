#include "documents/export_json.h"

#include <utility>

#include "documents/export_text.h"
#include "documents/json_writer.h"

namespace zor2 {

namespace {

void WriteSummary(const RunSummary& summary, JsonWriter& json) {
  json.BeginObject();
  json.Member("verdict", VerdictName(VerdictOf(summary)));
  const int total = TotalFindings(summary);
  json.Member("findings", total);
  json.Member("new", total - summary.accepted);
  json.Member("accepted", summary.accepted);
  json.Key("counts_by_code");
  json.BeginObject();
  for (const MessageType& type : kMessageTypes) {
    json.Member(type.id, summary.counts_by_code[static_cast<size_t>(type.code)]);
  }
  json.EndObject();
  json.Member("files", summary.files);
  json.Member("frameworks", summary.frameworks);
  json.Member("pairs_compared", summary.pairs_compared);
  json.Member("pairs_skipped", summary.pairs_skipped);
  json.Member("files_checked", summary.files_checked);
  json.Member("nothing_checked", summary.nothing_checked);
  std::vector<std::string> missing;
  for (const Absence& absence : summary.missing_documents) missing.push_back(absence.name);
  json.Member("missing_counterparts", missing);
  json.Key("without_counterpart");
  WriteAbsences(summary, json);
  json.Member("stale_baseline_entries", summary.stale_baseline_entries);
  json.Key("failures");
  json.BeginArray();
  for (const RunFailure& failure : summary.failures) {
    json.BeginObject();
    json.Member("path", failure.path);
    json.Member("reason", failure.reason);
    json.EndObject();
  }
  json.EndArray();
  json.EndObject();
}

void WriteFinding(const Finding& finding, JsonWriter& json) {
  const MessageType& type = MessageTypeOf(finding.code);
  json.BeginObject();
  json.Member("code", type.id);
  json.Member("full_name", type.full_name);
  json.Member("framework", finding.framework);
  json.Member("group", finding.group);
  json.Member("file", finding.file);
  json.Member("class", finding.class_name);
  json.Member("method", finding.method);
  json.Member("signature", finding.signature);
  json.Member("argument", finding.argument);
  json.Member("line", finding.line);
  json.Member("reference_value", finding.reference_value);
  json.Member("checked_value", finding.checked_value);
  json.Member("more_replacements", finding.more_replacements);
  json.Member("accepted", finding.accepted);
  json.Member("reason", finding.reason);
  json.EndObject();
}

}  // namespace

void WriteAbsences(const RunSummary& summary, JsonWriter& json) {
  json.BeginArray();
  for (const auto& [kind, absences] : {std::pair{"document", &summary.missing_documents},
                                       std::pair{"framework", &summary.missing_frameworks}}) {
    for (const Absence& absence : *absences) {
      json.BeginObject();
      json.Member("kind", kind);
      json.Member("name", absence.name);
      json.Member("accepted", absence.accepted);
      json.Member("reason", absence.reason);
      json.EndObject();
    }
  }
  json.EndArray();
}

std::string ExportJson(const RunDescription& run, const RunSummary& summary,
                       const std::vector<Finding>& findings) {
  std::string out;
  out.reserve(1024 + findings.size() * 512);
  JsonWriter json(&out);
  json.BeginObject();
  json.Member("format_version", 1);
  json.Key("tool");
  json.BeginObject();
  json.Member("name", "zor2check");
  json.Member("version", run.tool_version);
  json.EndObject();
  json.Key("run");
  json.BeginObject();
  json.Member("reference", run.reference);
  json.Member("checked", run.checked);
  json.Member("report", run.report);
  json.Member("options", run.options);
  json.EndObject();
  json.Key("summary");
  WriteSummary(summary, json);
  json.Key("findings");
  json.BeginArray();
  for (const Finding& finding : findings) WriteFinding(finding, json);
  json.EndArray();
  json.EndObject();
  out.push_back('\n');
  return out;
}

}  // namespace zor2
