#pragma once

#include <gtest/gtest.h>
#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "platform/xml/document.h"
#include "platform/xml/output_element.h"
#include "platform/xml/reader.h"

namespace zor2::testing {

// A test fixture with a fresh directory of its own, removed with everything
// in it when the test ends.
class TempDirTest : public ::testing::Test {
 protected:
  void SetUp() override {
    std::string pattern = (std::filesystem::temp_directory_path() / "zor2test_XXXXXX").string();
    ASSERT_NE(mkdtemp(pattern.data()), nullptr);
    dir_ = pattern;
  }
  void TearDown() override { std::filesystem::remove_all(dir_); }

  // The path of `name` inside the directory.
  std::string Path(const std::string& name) const { return (dir_ / name).string(); }

  // Writes `text` to `name` inside the directory and answers its path.
  std::string Write(const std::string& name, std::string_view text) const {
    std::ofstream(Path(name), std::ios::binary) << text;
    return Path(name);
  }

  // The whole contents of the file at `path`, empty when it cannot be read.
  static std::string Contents(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(in), {});
  }

  std::filesystem::path dir_;
};

// The document parsed from `text`; a parse fault fails the test.
inline std::unique_ptr<xml::Document> Parse(std::string_view text) {
  std::unique_ptr<xml::Document> document;
  xml::ReadError err;
  EXPECT_TRUE(xml::ReadDocumentText(text, &document, &err))
      << err.reason << " at " << err.line << ":" << err.column;
  return document;
}

// The tags of the direct children of `element`, in order.
inline std::vector<std::string> ChildTags(const xml::Element& element) {
  std::vector<std::string> tags;
  for (const xml::Element* child = element.first_child(); child; child = child->next_sibling()) {
    tags.push_back(child->tag());
  }
  return tags;
}

// What `rewrite` makes of `value`, or "<unchanged>" when it answers that the
// value stays; a rewrite that answers so must leave its output alone.
inline std::string Rewritten(xml::ValueRewrite rewrite, std::string_view value) {
  std::string out = "<unchanged>";
  const bool changed = rewrite(value, &out);
  EXPECT_EQ(changed, out != "<unchanged>") << value;
  return out;
}

// The tree of `root` on one line: start tags with their attributes, nesting
// shown by the end tags.
inline std::string Shape(const xml::OutputElement& root) {
  std::string text;
  xml::AppendDocument(root, &text);
  std::string shape;
  for (size_t start = text.find('\n') + 1; start < text.size();) {
    size_t end = text.find('\n', start);
    size_t indent = text.find_first_not_of(' ', start);
    shape += text.substr(indent, end - indent);
    start = end + 1;
  }
  return shape;
}

}  // namespace zor2::testing
