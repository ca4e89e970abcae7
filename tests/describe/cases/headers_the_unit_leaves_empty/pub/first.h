#ifndef SHARED_GUARD
#define SHARED_GUARD
struct First {
  void One();
};
#endif
