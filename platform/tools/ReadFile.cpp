#include "platform/tools/ReadFile.h"

#include <cstdio>
#include <memory>
#include <string>

namespace {

struct FileCloser {
  void operator()(std::FILE* file) const { std::fclose(file); }
};

// Reads the whole file into `content`; false when it cannot be opened or read
// (a directory opens but fails to read).
bool ReadWholeFile(const char* path, std::string& content) {
  std::unique_ptr<std::FILE, FileCloser> file(std::fopen(path, "rb"));
  if (!file) return false;
  const size_t chunk = 1 << 16;
  size_t used = 0;
  for (;;) {
    content.resize(used + chunk);
    size_t got = std::fread(content.data() + used, 1, chunk, file.get());
    used += got;
    if (got < chunk) break;
  }
  content.resize(used);
  return !std::ferror(file.get());
}

bool IsBlank(char c) {
  return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

}  // namespace

// Quotes may open and close anywhere inside an item ("a b"c gives `a bc`); an
// unterminated quote runs to the end of the file.
int ReadFile(const char* path, QEXListValQEXString& items) {
  std::string content;
  if (path == nullptr || !ReadWholeFile(path, content)) return 1;

  std::string item;
  bool in_item = false;
  bool quoted = false;
  for (char c : content) {
    if (c == '"') {
      quoted = !quoted;
      in_item = true;  // "" alone is an empty item
    } else if (!quoted && IsBlank(c)) {
      if (in_item) items.Append(std::move(item));
      item.clear();
      in_item = false;
    } else {
      item.push_back(c);
      in_item = true;
    }
  }
  if (in_item) items.Append(std::move(item));
  return 0;
}
