// @ZOR2Level L1
// @ZOR2Usage U1
#pragma once

namespace shapes {

class [[deprecated("M4R18")]] OldGrid {
 public:
  void Snap();
};

/// @deprecated M4R18
class OldRuler {
 public:
  int Ticks() const;
};

}  // namespace shapes
