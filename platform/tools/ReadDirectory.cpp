#include "platform/tools/ReadDirectory.h"

#include <algorithm>
#include <filesystem>
#include <string>
#include <system_error>
#include <vector>

namespace {

// Splits a pattern "<dir>/*" into the directory to open and the prefix that
// makes an entry name a full path. A pattern without a final "*" component is
// taken as the directory itself.
void SplitPattern(const std::string& pattern, std::string& directory, std::string& prefix) {
  if (pattern == "*") {
    directory = ".";
    prefix.clear();
    return;
  }
  if (pattern.size() >= 2 && pattern.compare(pattern.size() - 2, 2, "/*") == 0) {
    prefix = pattern.substr(0, pattern.size() - 1);
    directory = prefix;
    return;
  }
  directory = pattern;
  prefix = (TAFileName(pattern) + "").str();
}

}  // namespace

int ReadDirectory(const TAFileName& pattern, QEXListValTAFileName& files) {
  std::string directory;
  std::string prefix;
  SplitPattern(pattern.str(), directory, prefix);

  std::error_code ec;
  std::vector<std::string> names;
  std::filesystem::directory_iterator it(directory, ec);
  for (; !ec && it != std::filesystem::directory_iterator(); it.increment(ec)) {
    std::error_code type_ec;
    // is_regular_file on the entry follows symbolic links; a dangling link
    // is simply not a regular file.
    if (it->is_regular_file(type_ec)) names.push_back(it->path().filename().string());
  }
  if (ec) return 1;

  std::sort(names.begin(), names.end());
  for (const std::string& name : names) files.Append(TAFileName(prefix + name));
  return 0;
}
