// What clients can reach: a class nested in a private section is not part of
// the interface; one in a protected section is, for derived classes. The
// compiler's own default constructor stands for a written one.
#pragma once

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

}  // namespace ui
