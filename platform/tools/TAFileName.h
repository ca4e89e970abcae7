#pragma once

#include <string>

#include "platform/tools/QEXListVal.h"

// A file-system path. Default-built it is null (no path set); assigning any
// string, even an empty one, makes it non-null.
class TAFileName {
 public:
  TAFileName() = default;
  explicit TAFileName(std::string path) : path_(std::move(path)), set_(true) {}
  TAFileName& operator=(const std::string& path);

  const char* c_str() const { return path_.c_str(); }
  const std::string& str() const { return path_; }

  // True while no path was ever set.
  bool IsNull() const { return !set_; }
  // True only for an existing regular file (following links).
  bool IsFile() const;
  // True only for an existing directory (following links).
  bool IsDirectory() const;

  // The path joined with `component` as a further component, with "/" between
  // them unless the path already ends with one.
  TAFileName operator+(const std::string& component) const;

  // With `which` = 1: the last path component, extension included. Other
  // values are not used and give the same answer.
  std::string basename(int which) const;

 private:
  std::string path_;
  bool set_ = false;
};

using QEXListValTAFileName = QEXListVal<TAFileName>;
