// @ZOR2Level L1
// @ZOR2Usage U1
#pragma once

namespace shapes {

class LegacyShape {
 public:
  void Draw(int iMode);
};

}  // namespace shapes
