#ifndef SHARED_GUARD
#define SHARED_GUARD
struct Second {
  void Two();
};
#endif
