// Not part of the checked interfaces.
// @ZOR2Level L2
// @ZOR2Usage U1
#pragma once

namespace shapes {

class Cache {
 public:
  void Flush(bool iAll);
};

}  // namespace shapes
