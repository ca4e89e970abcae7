// @ZOR2Level L1
// @ZOR2Usage U1
#pragma once

#include <string>

namespace shapes {

class Text {
 public:
  std::string Content() const;
};

}  // namespace shapes
