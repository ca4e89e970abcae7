#include "describe/header_listing.h"

#include <algorithm>
#include <filesystem>
#include <system_error>

namespace zor2::describe {

std::string HeaderPath(const std::string& dir, const std::string& name) {
  if (dir.empty()) return name;
  return dir.back() == '/' ? dir + name : dir + "/" + name;
}

bool IsHeaderName(const std::string& name) {
  for (const char* extension : {".h", ".hh", ".hpp", ".hxx", ".h++"}) {
    const std::string_view end(extension);
    if (name.size() > end.size() && name.compare(name.size() - end.size(), end.size(), end) == 0) {
      return true;
    }
  }
  return false;
}

bool ListHeaders(const std::string& dir, std::vector<std::string>* names, std::string* err) {
  namespace fs = std::filesystem;
  names->clear();
  bool complete = true;
  auto fail = [&complete, err](const fs::path& path, const std::error_code& code) {
    if (complete) *err = path.string() + ": " + code.message();
    complete = false;
  };
  std::error_code code;
  if (!fs::is_directory(dir, code)) {
    fail(dir, code ? code : std::make_error_code(std::errc::not_a_directory));
    return false;
  }
  // Directories still to list, relative to `dir`; a stack, so that the depth
  // of the tree never bounds the walk.
  std::vector<std::string> pending = {""};
  while (!pending.empty()) {
    const std::string relative = std::move(pending.back());
    pending.pop_back();
    const fs::path path = relative.empty() ? fs::path(dir) : fs::path(dir) / relative;
    fs::directory_iterator it(path, code);
    if (code) {
      fail(path, code);
      continue;
    }
    for (; it != fs::directory_iterator(); it.increment(code)) {
      const std::string name = it->path().filename().string();
      const std::string child = relative.empty() ? name : relative + "/" + name;
      std::error_code kind_code;
      if (it->is_directory(kind_code) && !it->is_symlink(kind_code)) {
        pending.push_back(child);
      } else if (IsHeaderName(name) && it->is_regular_file(kind_code)) {
        names->push_back(child);
      }
    }
    if (code) fail(path, code);
  }
  std::sort(names->begin(), names->end());
  return complete;
}

}  // namespace zor2::describe
