#include "platform/tools/paths.h"

#include <algorithm>
#include <filesystem>
#include <system_error>

namespace zor2 {

std::string JoinPath(const std::string& directory, const std::string& name) {
  if (directory.empty()) return name;
  if (directory.back() == '/') return directory + name;
  return directory + "/" + name;
}

std::string BaseName(const std::string& path) {
  std::string::size_type slash = path.rfind('/');
  return slash == std::string::npos ? path : path.substr(slash + 1);
}

bool IsRegularFile(const std::string& path) {
  std::error_code ec;
  return !path.empty() && std::filesystem::is_regular_file(path, ec);
}

bool IsDirectory(const std::string& path) {
  std::error_code ec;
  return !path.empty() && std::filesystem::is_directory(path, ec);
}

bool ListRegularFiles(const std::string& directory, std::vector<std::string>* paths,
                      std::string* err) {
  std::error_code ec;
  std::vector<std::string> names;
  std::filesystem::directory_iterator it(directory.empty() ? "." : directory, ec);
  for (; !ec && it != std::filesystem::directory_iterator(); it.increment(ec)) {
    std::error_code type_ec;
    // is_regular_file on the entry follows symbolic links; a dangling link is
    // simply not a regular file.
    if (it->is_regular_file(type_ec)) names.push_back(it->path().filename().string());
  }
  if (ec) {
    *err = ec.message();
    return false;
  }
  std::sort(names.begin(), names.end());
  for (const std::string& name : names) paths->push_back(JoinPath(directory, name));
  return true;
}

}  // namespace zor2
