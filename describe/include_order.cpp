#include "describe/include_order.h"

#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>
#include <set>
#include <sstream>
#include <string_view>

#include "describe/header_listing.h"
#include "describe/source_scan.h"

namespace zor2::describe {
namespace {

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
  ScanDirectives(source, [&names](std::string_view directive) {
    const std::string target = IncludeTarget(directive);
    if (!target.empty()) names.push_back(target.substr(1, target.size() - 2));
  });
  return names;
}

std::vector<size_t> IncludeOrder(const std::string& dir, const std::vector<std::string>& headers,
                                 const std::vector<std::string>& roots) {
  std::map<std::string, size_t> index_of_path;
  std::set<std::string_view> base_names;  // an include of another name is no header of these
  for (size_t h = 0; h < headers.size(); ++h) {
    index_of_path[Normal(HeaderPath(dir, headers[h]))] = h;
    const size_t slash = headers[h].rfind('/');
    base_names.insert(
        std::string_view(headers[h]).substr(slash == std::string::npos ? 0 : slash + 1));
  }
  std::vector<bool> included(headers.size(), false);
  for (size_t h = 0; h < headers.size(); ++h) {
    const std::string path = HeaderPath(dir, headers[h]);
    const std::string beside = std::filesystem::path(path).parent_path().string();
    for (const std::string& name : IncludedNames(FileText(path))) {
      const size_t slash = name.rfind('/');
      if (base_names.count(
              std::string_view(name).substr(slash == std::string::npos ? 0 : slash + 1)) == 0) {
        continue;
      }
      std::vector<std::string> places = {HeaderPath(beside, name)};
      for (const std::string& root : roots) places.push_back(HeaderPath(root, name));
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
