#pragma once

#include <string>
#include <string_view>

namespace zor2 {

// Appends `text` as a log line shows it: each control character escaped (tab,
// line feed and carriage return as "\t", "\n" and "\r", the others and DEL as
// "\xHH"), so that the text never splits or garbles its line. Other bytes are
// kept.
void AppendPrintable(std::string_view text, std::string* out);

// `path` as a log line shows it (AppendPrintable), for messages written
// outside the log.
std::string PrintablePath(std::string_view path);

}  // namespace zor2
