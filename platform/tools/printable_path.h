#pragma once

#include <string>
#include <string_view>

namespace zor2 {

// `path` as a log line shows it: each control character escaped (tab, line
// feed and carriage return as "\t", "\n" and "\r", the others as "\xHH"), so
// that a path never splits or garbles its line. Other bytes are kept.
std::string PrintablePath(std::string_view path);

}  // namespace zor2
