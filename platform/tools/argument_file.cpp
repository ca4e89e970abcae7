#include "platform/tools/argument_file.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <iterator>
#include <new>

#include "platform/tools/file_descriptor.h"

namespace zor2 {
namespace {

// Reads the whole file into `content`; false with errno set when it cannot be
// opened or read (a directory opens but fails to read).
bool ReadWholeFile(const std::string& path, std::string* content) {
  FileDescriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC));
  if (!file.valid()) return false;
  constexpr size_t kChunk = 1 << 16;
  size_t used = 0;
  for (;;) {
    content->resize(used + kChunk);
    ssize_t got = ::read(file.get(), content->data() + used, kChunk);
    if (got < 0) {
      if (errno == EINTR) continue;
      return false;
    }
    if (got == 0) break;
    used += static_cast<size_t>(got);
  }
  content->resize(used);
  return true;
}

bool IsBlank(char c) {
  return c == ' ' || c == '\t' || c == '\r' || c == '\n';
}

// Quotes may open and close anywhere inside an item ("a b"c gives `a bc`); an
// unterminated quote runs to the end of the file.
void SplitItems(const std::string& content, std::vector<std::string>* items) {
  std::string item;
  bool in_item = false;
  bool quoted = false;
  for (char c : content) {
    if (c == '"') {
      quoted = !quoted;
      in_item = true;
    } else if (!quoted && IsBlank(c)) {
      if (in_item) items->push_back(std::move(item));
      item.clear();
      in_item = false;
    } else {
      item.push_back(c);
      in_item = true;
    }
  }
  if (in_item) items->push_back(std::move(item));
}

}  // namespace

bool ReadArgumentFile(const std::string& path, std::vector<std::string>* items, std::string* err) {
  // A file that does not fit in memory (one that never ends, as /dev/zero)
  // cannot be read either.
  try {
    std::string content;
    if (!ReadWholeFile(path, &content)) {
      *err = std::strerror(errno);
      return false;
    }
    std::vector<std::string> read;
    SplitItems(content, &read);
    items->insert(items->end(), std::make_move_iterator(read.begin()),
                  std::make_move_iterator(read.end()));
  } catch (const std::bad_alloc&) {
    *err = std::strerror(ENOMEM);
    return false;
  }
  return true;
}

}  // namespace zor2
