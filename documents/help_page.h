#pragma once

#include <string>

namespace zor2 {

// The HTML page that explains every message type, in the table's order: an
// anchor named after its code, its full name and its help text as live HTML.
std::string HelpPageText();

}  // namespace zor2
