// @ZOR2Level L1
// @ZOR2Usage U1
#pragma once

#include <vector>

#include "shapes/shape.h"

namespace shapes {

/// No longer scriptable.
class Group {
 public:
  int Count() const;
  Shape* At(int iIndex);
};

}  // namespace shapes
