// @ZOR2Level L1
// @ZOR2Usage U1
#pragma once

#include <vector>

#include "shapes/shape.h"

namespace shapes {

/// @ZOR2Aut
class Group {
 public:
  int Count() const;
  Shape* At(int iIndex);
};

class Layer {
 public:
  void Lock();
};

}  // namespace shapes
