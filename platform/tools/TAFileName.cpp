#include "platform/tools/TAFileName.h"

#include <filesystem>
#include <system_error>

TAFileName& TAFileName::operator=(const std::string& path) {
  path_ = path;
  set_ = true;
  return *this;
}

bool TAFileName::IsFile() const {
  std::error_code ec;
  return !path_.empty() && std::filesystem::is_regular_file(path_, ec);
}

bool TAFileName::IsDirectory() const {
  std::error_code ec;
  return !path_.empty() && std::filesystem::is_directory(path_, ec);
}

TAFileName TAFileName::operator+(const std::string& component) const {
  // An empty path adds nothing, so that "" + "x" names "x" in the current
  // directory rather than "/x" at the root.
  if (path_.empty()) return TAFileName(component);
  if (path_.back() == '/') return TAFileName(path_ + component);
  return TAFileName(path_ + "/" + component);
}

std::string TAFileName::basename(int /*which*/) const {
  // A path ending in "/" has an empty last component.
  std::string::size_type slash = path_.rfind('/');
  return slash == std::string::npos ? path_ : path_.substr(slash + 1);
}
