// @ZOR2Level L1
// @ZOR2Usage U3
#pragma once

#include <string>

namespace shapes {

struct Style {
  std::string Font() const;
  int Weight() const;
};

}  // namespace shapes
