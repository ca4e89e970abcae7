// The yardstick against which zor2check's speed is judged: pugixml parsing the same inputs in
// place, without entity decoding, and touching every attribute value.
//
//   pugixml_yardstick PATH...
//
// Each PATH is a document, or a directory whose regular files are all taken (in name order).
// Every document is read into memory whole, and each "@" that begins an attribute name is
// replaced by "_", since pugixml rejects such names; none of that is timed. What is timed is, for
// each document in turn, parsing it in place and visiting every element and attribute. The
// result is one line on stdout, the elapsed seconds first:
//
//   0.512 s, 2 documents, 209715200 bytes, 2400000 elements, 7100000 attributes, checksum 123
//
// A document that does not parse is named on stderr with its offset and line, and the exit
// status is 1; the yardstick thus also checks that generated workspaces are well-formed.

#include <algorithm>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <pugixml.hpp>
#include <string>
#include <vector>

namespace {

struct Document {
  std::string path;
  std::vector<char> text;
};

bool ReadWhole(const std::string& path, std::vector<char>& text) {
  std::FILE* file = std::fopen(path.c_str(), "rb");
  if (file == nullptr) return false;
  std::error_code error;
  text.resize(std::filesystem::file_size(path, error));
  bool ok = !error && std::fread(text.data(), 1, text.size(), file) == text.size();
  std::fclose(file);
  return ok;
}

// Replaces each "@" that begins an attribute name, that is one that follows white space inside a
// tag and outside a quoted value, by "_".
void RenameAtAttributes(std::vector<char>& text) {
  bool in_tag = false;
  char quote = 0;
  char previous = 0;
  for (char& c : text) {
    if (quote != 0) {
      if (c == quote) quote = 0;
    } else if (c == '<') {
      in_tag = true;
    } else if (c == '>') {
      in_tag = false;
    } else if (in_tag && (c == '"' || c == '\'')) {
      quote = c;
    } else if (in_tag && c == '@' && (previous == ' ' || previous == '\t' || previous == '\n')) {
      c = '_';
    }
    previous = c;
  }
}

// Appends the documents named by `path`: the file itself, or the regular files of a directory.
bool CollectDocuments(const std::string& path, std::vector<Document>& documents) {
  std::error_code error;
  std::vector<std::string> paths;
  if (std::filesystem::is_directory(path, error)) {
    for (const auto& entry : std::filesystem::directory_iterator(path, error)) {
      if (entry.is_regular_file()) paths.push_back(entry.path().string());
    }
    std::sort(paths.begin(), paths.end());
  } else {
    paths.push_back(path);
  }
  for (std::string& p : paths) {
    Document document{std::move(p), {}};
    if (!ReadWhole(document.path, document.text)) {
      std::perror(document.path.c_str());
      return false;
    }
    RenameAtAttributes(document.text);
    documents.push_back(std::move(document));
  }
  return !error;
}

struct Tally {
  uint64_t elements = 0;
  uint64_t attributes = 0;
  uint64_t checksum = 0;  // the sum of the first bytes of the values, so none is skipped
};

// Visits every node of the tree, without recursion.
void Touch(const pugi::xml_document& document, Tally& tally) {
  pugi::xml_node node = document.first_child();
  while (node) {
    if (node.type() == pugi::node_element) ++tally.elements;
    for (pugi::xml_attribute a = node.first_attribute(); a; a = a.next_attribute()) {
      ++tally.attributes;
      tally.checksum += static_cast<unsigned char>(a.value()[0]);
    }
    if (node.first_child()) {
      node = node.first_child();
      continue;
    }
    while (node && !node.next_sibling()) node = node.parent();
    if (node) node = node.next_sibling();
  }
}

long LineOf(const std::vector<char>& text, ptrdiff_t offset) {
  return 1 +
         std::count(text.begin(), text.begin() + std::min<ptrdiff_t>(offset, text.size()), '\n');
}

}  // namespace

int main(int argc, char** argv) {
  if (argc < 2) {
    std::fprintf(stderr, "usage: pugixml_yardstick PATH...\n");
    return 2;
  }
  std::vector<Document> documents;
  for (int i = 1; i < argc; ++i) {
    if (!CollectDocuments(argv[i], documents)) return 2;
  }
  uint64_t bytes = 0;
  for (const Document& d : documents) bytes += d.text.size();

  Tally tally;
  auto start = std::chrono::steady_clock::now();
  for (Document& d : documents) {
    pugi::xml_document tree;
    pugi::xml_parse_result result = tree.load_buffer_inplace(
        d.text.data(), d.text.size(), pugi::parse_minimal, pugi::encoding_utf8);
    if (!result) {
      std::fprintf(stderr, "%s:%ld: %s (offset %td)\n", d.path.c_str(),
                   LineOf(d.text, result.offset), result.description(), result.offset);
      return 1;
    }
    Touch(tree, tally);
  }
  std::chrono::duration<double> elapsed = std::chrono::steady_clock::now() - start;

  std::printf("%.3f s, %zu documents, %llu bytes, %llu elements, %llu attributes, checksum %llu\n",
              elapsed.count(), documents.size(), static_cast<unsigned long long>(bytes),
              static_cast<unsigned long long>(tally.elements),
              static_cast<unsigned long long>(tally.attributes),
              static_cast<unsigned long long>(tally.checksum));
  return 0;
}
