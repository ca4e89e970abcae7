// What clients can reach: a class nested in a private section is not part of
// the interface; one in a protected section is, for derived classes. The
// compiler's own default constructor stands for a written one.
#pragma once

#include <memory>

namespace ui {

class Widget {
 public:
  Widget();
  void Show();

 protected:
  struct Hook {
    void Call();
  };

 private:
  struct Impl {
    void Secret();
  };
};

struct Options {
  int level;
};

// Not copyable, for its member's member: saying so changes nothing.
struct Inner {
  std::unique_ptr<int> value;
};
struct Holder {
  Inner inner;
};

}  // namespace ui
