// @ZOR2Level L1
// @ZOR2Usage U1
#pragma once

namespace shapes {

/// @deprecated M4R17
class OldCanvas {
 public:
  void Clear();
};

}  // namespace shapes
