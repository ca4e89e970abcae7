#include "driver/ComparisonRun.h"

#include <memory>
#include <optional>
#include <string>

#include "documents/HelpPage.h"
#include "documents/ReportDocument.h"
#include "documents/TypeNameNormalization.h"
#include "platform/tools/ReadDirectory.h"
#include "platform/tools/XMLString.h"
#include "platform/tools/ZOROFStream.h"
#include "platform/xml/QEXVBTXMLNode.h"
#include "rules/FrameworkComparison.h"

namespace {

enum class InputMode { kFilePair, kDirectoryPair, kUnusable };

InputMode ChooseInputMode(const TAFileName& reference, const TAFileName& checked) {
  if (reference.IsFile() && checked.IsFile()) return InputMode::kFilePair;
  if (reference.IsDirectory() && checked.IsDirectory()) return InputMode::kDirectoryPair;
  return InputMode::kUnusable;
}

void ReportFailure(const TAFileName& path, const std::string& reason) {
  ZORerr << "ERROR: " << path.str() << ": " << reason << endl;
}

// One pass over the inputs: the shared report and whether anything failed.
class ComparisonRun {
 public:
  explicit ComparisonRun(const RunConfiguration& config)
      : config_(config), report_(QEXVBTXMLNode::CreateNode("XmlDiff")) {}

  ExitStatus Run() {
    CompareInputs();
    WriteReport();
    WriteHelpPage();
    return incomplete_ ? ExitStatus::kIncomplete : ExitStatus::kDone;
  }

 private:
  void CompareInputs() {
    switch (ChooseInputMode(config_.referencePath, config_.checkedPath)) {
      case InputMode::kFilePair:
        ComparePair(config_.referencePath, config_.checkedPath);
        return;
      case InputMode::kDirectoryPair:
        CompareDirectories();
        return;
      case InputMode::kUnusable:
        ZORout << " Pb with input (-r or -c) " << endl;
        incomplete_ = true;
        return;
    }
  }

  // Pairs each reference document with the checked document of the same name;
  // a reference document without one is passed over silently.
  void CompareDirectories() {
    QEXListValTAFileName entries;
    if (ReadDirectory(config_.referencePath + "*", entries) != 0) {
      ReportFailure(config_.referencePath, "cannot list the directory");
      incomplete_ = true;
      return;
    }
    for (int i = 1; i <= entries.Size(); ++i) {
      TAFileName checked = config_.checkedPath + entries[i].basename(1);
      if (checked.IsFile()) ComparePair(entries[i], checked);
    }
  }

  // The documents of a pair live only for the time of this call.
  void ComparePair(const TAFileName& referencePath, const TAFileName& checkedPath) {
    // Both documents are read even when the first fails, so that every fault
    // is reported in one run.
    std::unique_ptr<QEXVBTXMLNode> reference = Load(referencePath);
    std::unique_ptr<QEXVBTXMLNode> checked = Load(checkedPath);
    if (!reference || !checked) return;
    Prepare(*reference, *checked);
    QEXVBTXMLNode* report = report_.get();
    CompareFrameworks(reference.get(), checked.get(), report);
  }

  std::unique_ptr<QEXVBTXMLNode> Load(const TAFileName& path) {
    XMLReadError error;
    std::unique_ptr<QEXVBTXMLNode> document = QEXVBTXMLNode::CreateFromFile(path.c_str(), error);
    if (document) return document;
    incomplete_ = true;
    if (error.line > 0) {
      ZORerr << "ERROR: " << path.str() << ":" << error.line << ":" << error.column << ": "
             << error.reason << endl;
    } else {
      ReportFailure(path, error.reason);
    }
    return nullptr;
  }

  // Type names are normalised before entity references are decoded, so that
  // the normalisation only ever sees the text as written in the document.
  static void Prepare(QEXVBTXMLNode& reference, QEXVBTXMLNode& checked) {
    changeAttributeValues(&reference, NormalizeTypeNames);
    changeAttributeValues(&checked, NormalizeTypeNames);
    changeAttributeValues(&reference, decodeXMLString);
    changeAttributeValues(&checked, decodeXMLString);
  }

  void WriteReport() {
    std::string reason;
    if (FinishReport(*report_, config_.outputPath.c_str(), reason) == 0) return;
    ReportFailure(config_.outputPath, reason);
    incomplete_ = true;
  }

  void WriteHelpPage() {
    if (config_.helpPagePath.IsNull()) return;
    if (WriteHelpFile(config_.helpPagePath.c_str()) != 0) incomplete_ = true;
  }

  const RunConfiguration& config_;
  std::unique_ptr<QEXVBTXMLNode> report_;
  bool incomplete_ = false;
};

}  // namespace

ExitStatus RunComparison(const RunConfiguration& config) {
  return ComparisonRun(config).Run();
}

ExitStatus RunProgram(int argc, const char* const* argv) {
  RunConfiguration config;
  std::optional<ExitStatus> ended = ReadCommandLine(argc, argv, config);
  ExitStatus status = ended ? *ended : RunComparison(config);
  ZORout.flush();
  ZORerr.flush();
  return status;
}
