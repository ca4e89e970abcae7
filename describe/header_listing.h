#pragma once

#include <string>
#include <vector>

namespace zor2::describe {

// The path of the header `name` (relative to `dir`) as it is opened: `dir`
// and `name` joined with one '/', or `name` alone when `dir` is empty.
std::string HeaderPath(const std::string& dir, const std::string& name);

// Whether `name` ends like a C++ header: .h, .hh, .hpp, .hxx or .h++.
bool IsHeaderName(const std::string& name);

// Sets `names` to the paths, relative to `dir` and with '/' between their
// parts, of the headers under `dir` and its subdirectories (symbolic links to
// files count, links to directories are not followed), sorted bytewise. False
// with the reason in `err` when `dir` or one of its subdirectories cannot be
// read; the headers that could be listed are still in `names`.
bool ListHeaders(const std::string& dir, std::vector<std::string>* names, std::string* err);

}  // namespace zor2::describe
