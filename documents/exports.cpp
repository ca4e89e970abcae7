#include "documents/exports.h"

#include "documents/export_html.h"
#include "documents/export_json.h"
#include "documents/export_markdown.h"
#include "documents/export_sarif.h"

namespace zor2 {

std::optional<ExportFormat> ExportFormatOf(const std::string& path) {
  const std::string::size_type dot = path.rfind('.');
  if (dot == std::string::npos || path.find('/', dot) != std::string::npos) return std::nullopt;
  const std::string extension = path.substr(dot);
  if (extension == ".json") return ExportFormat::kJson;
  if (extension == ".sarif") return ExportFormat::kSarif;
  if (extension == ".md") return ExportFormat::kMarkdown;
  if (extension == ".html") return ExportFormat::kHtml;
  return std::nullopt;
}

std::string ExportText(ExportFormat format, const RunDescription& run, const RunSummary& summary,
                       const std::vector<Finding>& findings) {
  switch (format) {
    case ExportFormat::kJson:
      return ExportJson(run, summary, findings);
    case ExportFormat::kSarif:
      return ExportSarif(run, summary, findings);
    case ExportFormat::kMarkdown:
      return ExportMarkdown(run, summary, findings);
    case ExportFormat::kHtml:
      return ExportHtml(run, summary, findings);
  }
  return {};
}

}  // namespace zor2
