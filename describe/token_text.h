#pragma once

#include <string>
#include <vector>

namespace zor2::describe {

// The text of a sequence of C++ tokens, spaced so that the same tokens give
// the same text whatever the layout of the source: one blank after a comma
// and between two tokens that would otherwise run into one ("unsigned int",
// "- -", "> >"), none elsewhere ("f(1, a+b)", "std::string(\"x  y\")").
std::string JoinTokens(const std::vector<std::string>& tokens);

}  // namespace zor2::describe
