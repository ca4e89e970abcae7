#pragma once
namespace app {
class Bad {
 public:
  Widget Make();
};
}  // namespace app
