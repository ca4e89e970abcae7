#include "describe/include_order.h"

#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>
#include <sstream>
#include <string_view>

namespace zor2::describe {
namespace {

std::string Joined(const std::string& dir, const std::string& name) {
  if (dir.empty()) return name;
  return dir.back() == '/' ? dir + name : dir + "/" + name;
}

std::string FileText(const std::string& path) {
  std::ifstream in(path, std::ios::binary);
  return std::string(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
}

// Whether `name` looks like the implementation part of another header, which
// that header includes ("logger-inl.h", "impl/x_impl.hpp").
bool IsPartName(std::string_view name) {
  const size_t slash = name.rfind('/');
  const std::string_view base = slash == std::string_view::npos ? name : name.substr(slash + 1);
  for (std::string_view mark : {"-inl.", "_inl.", ".inl.", "-impl.", "_impl.", ".impl."}) {
    if (base.find(mark) != std::string_view::npos) return true;
  }
  return false;
}

std::string Normal(const std::string& path) {
  return std::filesystem::path(path).lexically_normal().string();
}

}  // namespace

std::vector<std::string> IncludedNames(std::string_view source) {
  std::vector<std::string> names;
  size_t pos = 0;
  bool line_start = true;
  while (pos < source.size()) {
    const char c = source[pos];
    if (c == '\n') {
      line_start = true;
      ++pos;
    } else if (c == ' ' || c == '\t' || c == '\r') {
      ++pos;
    } else if (source.compare(pos, 2, "//") == 0) {
      while (pos < source.size() && source[pos] != '\n') ++pos;
    } else if (source.compare(pos, 2, "/*") == 0) {
      const size_t end = source.find("*/", pos + 2);
      pos = end == std::string_view::npos ? source.size() : end + 2;
    } else if (c == '#' && line_start) {
      size_t at = pos + 1;
      while (at < source.size() && (source[at] == ' ' || source[at] == '\t')) ++at;
      if (source.compare(at, 7, "include") == 0 && source.compare(at, 12, "include_next") != 0) {
        at += 7;
        while (at < source.size() && (source[at] == ' ' || source[at] == '\t')) ++at;
        const char close = at < source.size() && source[at] == '<' ? '>' : '"';
        if (at < source.size() && (source[at] == '<' || source[at] == '"')) {
          const size_t end = source.find_first_of(std::string{close, '\n'}, at + 1);
          if (end != std::string_view::npos && source[end] == close) {
            names.emplace_back(source.substr(at + 1, end - at - 1));
          }
        }
      }
      while (pos < source.size() && source[pos] != '\n') ++pos;
    } else {
      line_start = false;
      ++pos;
    }
  }
  return names;
}

std::vector<size_t> IncludeOrder(const std::string& dir, const std::vector<std::string>& headers,
                                 const std::vector<std::string>& roots) {
  std::map<std::string, size_t> index_of_path;
  for (size_t h = 0; h < headers.size(); ++h) index_of_path[Normal(Joined(dir, headers[h]))] = h;
  std::vector<bool> included(headers.size(), false);
  for (size_t h = 0; h < headers.size(); ++h) {
    const std::string path = Joined(dir, headers[h]);
    const std::string beside = std::filesystem::path(path).parent_path().string();
    for (const std::string& name : IncludedNames(FileText(path))) {
      std::vector<std::string> places = {Joined(beside, name)};
      for (const std::string& root : roots) places.push_back(Joined(root, name));
      for (const std::string& place : places) {
        const auto found = index_of_path.find(Normal(place));
        if (found != index_of_path.end() && found->second != h) {
          included[found->second] = true;
          break;
        }
      }
    }
  }
  // Headers that include each other (a header and its "-inl.h" part) are
  // both included: the part goes last.
  auto rank = [&](size_t h) { return (included[h] ? 2 : 0) + (IsPartName(headers[h]) ? 1 : 0); };
  std::vector<size_t> order;
  for (int wanted = 0; wanted < 4; ++wanted) {
    for (size_t h = 0; h < headers.size(); ++h) {
      if (rank(h) == wanted) order.push_back(h);
    }
  }
  return order;
}

}  // namespace zor2::describe
