#pragma once
namespace app {
class Extension {
 protected:
  virtual void Hook() = 0;
};
}  // namespace app
