#include "describe/header_describer.h"

#include <stdlib.h>
#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <future>
#include <memory>
#include <utility>

#include "describe/clang_handles.h"
#include "describe/include_order.h"
#include "platform/tools/background.h"

namespace zor2::describe {
namespace {

// The made-up main file of a unit of several headers: a relative name puts
// it in the working directory, against which the header paths are resolved
// as given.
constexpr char kMainName[] = "zor2describe-headers.cpp";

std::string IncludePath(const std::string& dir, const std::string& header) {
  if (dir.empty()) return header;
  return dir.back() == '/' ? dir + header : dir + "/" + header;
}

std::vector<std::string> CompilerArguments(const CompileSettings& settings, bool header_language) {
  // No error limit: clang's "too many errors" belongs to no header and would
  // make every header be compiled on its own.
  std::vector<std::string> arguments = {"-x", header_language ? "c++-header" : "c++",
                                        "-fparse-all-comments", "-ferror-limit=0"};
  for (const std::string& root : settings.roots) arguments.push_back("-I" + root);
  arguments.insert(arguments.end(), settings.arguments.begin(), settings.arguments.end());
  // A root given one level too deep (include/lib rather than include) still
  // finds "lib/other.h", after every other directory has been searched.
  for (const std::string& root : settings.roots) {
    std::filesystem::path parent = std::filesystem::path(root).lexically_normal();
    if (!parent.has_filename()) parent = parent.parent_path();
    for (int level = 0; level < 2; ++level) {
      parent = parent.parent_path();
      arguments.push_back("-idirafter" + (parent.empty() ? std::string(".") : parent.string()));
    }
  }
  return arguments;
}

// What the headers of a group include from elsewhere (the standard library,
// other libraries), compiled once into a precompiled header that each unit of
// one header then starts from. The file lives in a directory of its own,
// removed with this object.
class SharedPreamble {
 public:
  SharedPreamble() = default;
  SharedPreamble(const SharedPreamble&) = delete;
  SharedPreamble& operator=(const SharedPreamble&) = delete;
  ~SharedPreamble() {
    if (dir_.empty()) return;
    std::error_code ignored;
    std::filesystem::remove_all(dir_, ignored);
  }

  // Compiles the directives `includes` ("<vector>") into a precompiled header;
  // false when they do not compile on their own or the file cannot be made,
  // and each unit then compiles them itself.
  bool Build(const std::vector<std::string>& includes, const CompileSettings& settings) {
    if (includes.empty()) return false;
    const char* tmp = getenv("TMPDIR");
    std::string pattern =
        std::string(tmp != nullptr && *tmp != '\0' ? tmp : "/tmp") + "/zor2describe.XXXXXX";
    if (mkdtemp(pattern.data()) == nullptr) return false;
    dir_ = pattern;
    const std::string source = dir_ + "/shared.hpp";
    {
      std::ofstream out(source);
      for (const std::string& include : includes) out << "#include " << include << '\n';
      if (!out) return false;
    }
    const std::vector<std::string> arguments = CompilerArguments(settings, true);
    std::vector<const char*> argv;
    for (const std::string& argument : arguments) argv.push_back(argument.c_str());
    IndexHandle index(clang_createIndex(0, 0));
    CXTranslationUnit raw_unit = nullptr;
    const CXErrorCode code = clang_parseTranslationUnit2(
        index.get(), source.c_str(), argv.data(), static_cast<int>(argv.size()), nullptr, 0,
        CXTranslationUnit_Incomplete | CXTranslationUnit_ForSerialization |
            CXTranslationUnit_SkipFunctionBodies,
        &raw_unit);
    UnitHandle unit(raw_unit);
    if (code != CXError_Success || unit == nullptr) return false;
    for (unsigned i = 0; i < clang_getNumDiagnostics(unit.get()); ++i) {
      CXDiagnostic diagnostic = clang_getDiagnostic(unit.get(), i);
      const CXDiagnosticSeverity severity = clang_getDiagnosticSeverity(diagnostic);
      clang_disposeDiagnostic(diagnostic);
      if (severity >= CXDiagnostic_Error) return false;
    }
    const std::string path = dir_ + "/shared.pch";
    if (clang_saveTranslationUnit(unit.get(), path.c_str(), clang_defaultSaveOptions(unit.get())) !=
        CXSaveError_None) {
      return false;
    }
    path_ = path;
    return true;
  }

  // The precompiled header, or empty when there is none.
  const std::string& path() const { return path_; }

 private:
  std::string dir_;
  std::string path_;
};

// Compiles `headers` (relative to `dir`) as one translation unit and
// describes them, starting from the precompiled header `preamble` when one is
// given.
UnitOutcome DescribeUnit(const std::string& dir, const std::vector<std::string>& headers,
                         const CompileSettings& settings, const std::string& preamble) {
  UnitOutcome refused;
  refused.files.resize(headers.size());
  refused.diagnostics.resize(headers.size());
  refused.needs_own_unit.assign(headers.size(), false);
  // A single header is compiled as the main file itself, so that every
  // diagnostic points into it; several are included by a made-up main file.
  std::string main_text;
  bool any_refused = false;
  for (size_t h : IncludeOrder(dir, headers, settings.roots)) {
    const std::string path = IncludePath(dir, headers[h]);
    if (path.find_first_of("\"\n") != std::string::npos) {
      refused.diagnostics[h].push_back(path +
                                       ": a path holding a quote or a line end cannot be "
                                       "included");
      any_refused = true;
      continue;
    }
    main_text += "#include \"" + path + "\"\n";
  }
  const bool solo = headers.size() == 1;
  if (solo && any_refused) return refused;
  const std::string solo_path = solo ? IncludePath(dir, headers[0]) : "";

  std::vector<std::string> arguments = CompilerArguments(settings, false);
  if (!preamble.empty()) {
    arguments.push_back("-include-pch");
    arguments.push_back(preamble);
  }
  std::vector<const char*> argv;
  for (const std::string& argument : arguments) argv.push_back(argument.c_str());
  CXUnsavedFile main_file = {kMainName, main_text.data(),
                             static_cast<unsigned long>(main_text.size())};
  // Declarations that come from the precompiled header are not walked.
  IndexHandle index(clang_createIndex(preamble.empty() ? 0 : 1, 0));
  CXTranslationUnit raw_unit = nullptr;
  const CXErrorCode code = clang_parseTranslationUnit2(
      index.get(), solo ? solo_path.c_str() : kMainName, argv.data(), static_cast<int>(argv.size()),
      solo ? nullptr : &main_file, solo ? 0 : 1,
      CXTranslationUnit_SkipFunctionBodies | CXTranslationUnit_KeepGoing, &raw_unit);
  UnitHandle unit(raw_unit);
  if (code != CXError_Success || unit == nullptr) {
    for (size_t h = 0; h < headers.size(); ++h) {
      refused.diagnostics[h].push_back(IncludePath(dir, headers[h]) +
                                       ": libclang could not parse it (error " +
                                       std::to_string(static_cast<int>(code)) + ")");
    }
    return refused;
  }
  UnitOutcome outcome =
      WalkUnit(unit.get(), {dir, headers}, settings.roots, settings.walk, kMainName);
  for (size_t h = 0; h < headers.size(); ++h) {
    if (refused.diagnostics[h].empty()) continue;
    outcome.files[h].reset();
    outcome.diagnostics[h] = std::move(refused.diagnostics[h]);
  }
  return outcome;
}

// Compiles each header of `input` listed in `which` on its own, on up to
// `threads` threads; the outcomes come back in the order of `which`.
std::vector<UnitOutcome> DescribeOneByOne(const GroupInput& input, const std::vector<size_t>& which,
                                          const CompileSettings& settings,
                                          const std::string& preamble, unsigned threads,
                                          ProgressLine* progress) {
  std::vector<UnitOutcome> units(which.size());
  progress->AddWork(which.size());
  std::atomic<size_t> next{0};
  auto work = [&]() {
    for (size_t i = next++; i < which.size(); i = next++) {
      units[i] = DescribeUnit(input.dir, {input.headers[which[i]]}, settings, preamble);
      progress->Advance();
    }
  };
  std::vector<std::future<void>> helpers;
  for (unsigned t = 1; t < threads && t < which.size(); ++t) {
    helpers.push_back(RunInBackground(work));
  }
  work();
  for (std::future<void>& helper : helpers) helper.get();
  return units;
}

}  // namespace

GroupOutcome DescribeGroup(const GroupInput& input, const CompileSettings& settings,
                           unsigned threads, ProgressLine* progress) {
  GroupOutcome outcome;
  outcome.group.name = input.name;
  if (input.headers.empty()) return outcome;
  UnitOutcome whole = DescribeUnit(input.dir, input.headers, settings, "");

  // The headers to compile on their own: all of them when an error could not
  // be charged to one, else those the unit left empty.
  std::vector<size_t> alone;
  for (size_t h = 0; h < input.headers.size(); ++h) {
    if (whole.unattributed_errors || whole.needs_own_unit[h]) alone.push_back(h);
  }
  std::vector<UnitOutcome> units;
  if (!alone.empty()) {
    SharedPreamble preamble;
    preamble.Build(whole.outside_includes, settings);
    units = DescribeOneByOne(input, alone, settings, preamble.path(), threads, progress);
  }

  size_t next_alone = 0;
  for (size_t h = 0; h < input.headers.size(); ++h) {
    const bool own = next_alone < alone.size() && alone[next_alone] == h;
    UnitOutcome& unit = own ? units[next_alone++] : whole;
    const size_t slot = own ? 0 : h;
    if (unit.files[slot]) {
      outcome.group.files.push_back(std::move(*unit.files[slot]));
    } else {
      outcome.failures.push_back({input.headers[h], std::move(unit.diagnostics[slot])});
    }
  }
  outcome.stand_ins = std::move(whole.stand_ins);
  outcome.warnings = std::move(whole.warnings);
  for (UnitOutcome& unit : units) {
    outcome.warnings.insert(outcome.warnings.end(), unit.warnings.begin(), unit.warnings.end());
  }
  return outcome;
}

}  // namespace zor2::describe
