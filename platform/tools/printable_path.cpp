#include "platform/tools/printable_path.h"

namespace zor2 {

void AppendPrintable(std::string_view text, std::string* out) {
  size_t run = 0;
  for (size_t i = 0; i < text.size(); ++i) {
    const unsigned char byte = static_cast<unsigned char>(text[i]);
    if (byte >= 0x20 && byte != 0x7F) continue;
    // Runs of plain text are copied whole: most text needs no escape.
    out->append(text.substr(run, i - run));
    run = i + 1;
    if (byte == '\t') {
      out->append("\\t");
    } else if (byte == '\n') {
      out->append("\\n");
    } else if (byte == '\r') {
      out->append("\\r");
    } else {
      static constexpr char kHex[] = "0123456789ABCDEF";
      out->append("\\x");
      out->push_back(kHex[byte >> 4]);
      out->push_back(kHex[byte & 0xF]);
    }
  }
  out->append(text.substr(run));
}

std::string PrintablePath(std::string_view path) {
  std::string out;
  out.reserve(path.size());
  AppendPrintable(path, &out);
  return out;
}

}  // namespace zor2
