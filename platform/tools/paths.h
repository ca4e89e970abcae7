#pragma once

#include <string>
#include <vector>

namespace zor2 {

// `directory` joined with `name` as a further path component, with "/" between
// them unless `directory` already ends with one; an empty `directory` adds
// nothing, so that "" and "x" name "x" in the current directory.
std::string JoinPath(const std::string& directory, const std::string& name);

// The last component of `path`, extension included ("" for a path ending in
// "/").
std::string BaseName(const std::string& path);

// True only for an existing regular file, following links.
bool IsRegularFile(const std::string& path);
// True only for an existing directory, following links.
bool IsDirectory(const std::string& path);

// Appends to `paths` the full paths (JoinPath) of the regular files (links to
// regular files included) in `directory`, sorted by byte-wise name;
// sub-directories are not listed. False with the system's reason in `err` when
// the directory cannot be listed (nothing is appended then).
bool ListRegularFiles(const std::string& directory, std::vector<std::string>* paths,
                      std::string* err);

}  // namespace zor2
