#include "platform/tools/argument_file.h"

#include <cerrno>
#include <cstring>
#include <iterator>
#include <new>

#include "platform/tools/file_input.h"

namespace zor2 {
namespace {

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
  // Read like a document: a pipe or a device (one that never ends, as
  // /dev/zero) is refused without waiting, as is a file that cannot fit.
  try {
    std::string content;
    const ReadRoom room = [&content](size_t size, size_t) {
      content.resize(size);
      return content.data();
    };
    size_t length = 0;
    FileReadError error;
    if (!ReadRegularFile(path, room, &length, &error)) {
      *err = std::move(error.reason);
      return false;
    }
    content.resize(length);
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
