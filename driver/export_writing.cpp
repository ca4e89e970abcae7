#include "driver/export_writing.h"

#include <memory>
#include <new>

#include "documents/exports.h"
#include "platform/tools/file_output.h"

namespace zor2 {
namespace {

constexpr char kNoMemory[] = "not enough memory to make the export";

// Makes and writes the export at `path`; answers why it could not, or
// nothing.
std::string MakeAndWrite(const std::string& path, const RunDescription& run,
                         const RunSummary& summary, const std::vector<Finding>& findings) {
  try {
    std::string err;
    const std::string text = ExportText(*ExportFormatOf(path), run, summary, findings);
    return WriteFileAtomically(path, text, nullptr, &err) ? std::string() : err;
  } catch (const std::bad_alloc&) {
    return kNoMemory;
  }
}

}  // namespace

void WriteExports(const std::vector<std::string>& paths, const RunDescription& run,
                  const std::vector<Finding>& findings, RunSummary* summary, Executor& executor,
                  const std::function<void()>& write_others, const FailureReport& report_failure) {
  std::vector<const std::string*> pending;
  for (const std::string& path : paths) pending.push_back(&path);
  bool others_written = false;
  while (!pending.empty()) {
    // The threads read a copy, since failures are added to the summary while
    // they run.
    std::unique_ptr<const RunSummary> stated;
    try {
      stated = std::make_unique<const RunSummary>(*summary);
    } catch (const std::bad_alloc&) {
      for (const std::string* path : pending) report_failure(*path, kNoMemory);
      break;
    }
    std::vector<Executor::Handle<std::string>> tasks;
    for (const std::string* path : pending) {
      tasks.push_back(executor.Submit([path, &run, summary = stated.get(), &findings] {
        return MakeAndWrite(*path, run, *summary, findings);
      }));
    }
    if (!others_written) {
      write_others();
      others_written = true;
    }
    std::vector<const std::string*> written;
    for (size_t i = 0; i < tasks.size(); ++i) {
      const std::string err = tasks[i].Get();
      if (err.empty()) {
        written.push_back(pending[i]);
      } else {
        report_failure(*pending[i], err);
      }
    }
    // Those written say all that happened unless a failure came meanwhile.
    if (summary->failures.size() == stated->failures.size()) break;
    pending = std::move(written);
  }
  if (!others_written) write_others();
}

}  // namespace zor2
