#pragma once

#include <ostream>

#include "describe/describe_options.h"

namespace zor2::describe {

// Runs zor2describe with the program's arguments: reads the command line,
// describes the headers of each interface group, writes clang's diagnostics
// for the headers that do not compile and the document. Messages go to `out`
// ("-h") and `err`; returns the exit status.
DescribeStatus RunDescribe(int argc, const char* const* argv, std::ostream& out, std::ostream& err);

}  // namespace zor2::describe
