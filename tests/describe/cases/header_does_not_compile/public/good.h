#pragma once
namespace app {
class Good {
 public:
  void Run();
};
}  // namespace app
