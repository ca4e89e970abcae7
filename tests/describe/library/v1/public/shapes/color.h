// @ZOR2Level L1
// @ZOR2Usage U2
#pragma once

namespace shapes {

struct Color {
  unsigned char Red() const;
  unsigned char Green() const;
  unsigned char Blue() const;
};

}  // namespace shapes
