// What clients can reach: a class nested in a private section is not part of
// the interface; one in a protected section is, for derived classes. The
// compiler's own default constructor stands for a written one.
#pragma once

#include <memory>

namespace ui {

class Widget {
 public:
  void Show();

 protected:
  struct Hook {
    void Call(int times);
  };

 private:
  struct Details {
    int Secret();
  };
};

struct Options {
  explicit Options(int level);
  int level;
};

// Not copyable, for its member's member: saying so changes nothing.
struct Inner {
  std::unique_ptr<int> value;
};
struct Holder {
  Holder() = default;
  Holder(const Holder&) = delete;
  Inner inner;
};

}  // namespace ui
