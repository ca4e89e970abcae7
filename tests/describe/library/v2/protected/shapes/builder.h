// For the framework's own extensions.
// @ZOR2Level L1
// @ZOR2Usage U5
#pragma once

#include <string>

namespace shapes {

class Builder {
 public:
  virtual ~Builder();

 protected:
  virtual void Start(const std::string& iName) = 0;
  virtual void Add(int iKind) = 0;
  virtual void Finish() = 0;
};

}  // namespace shapes
