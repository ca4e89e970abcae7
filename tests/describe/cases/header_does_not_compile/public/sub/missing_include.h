#pragma once
#include "app/not_there.h"
namespace app {
class Lost {
 public:
  void Find();
};
}  // namespace app
