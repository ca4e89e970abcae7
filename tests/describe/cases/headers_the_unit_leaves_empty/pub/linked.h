#pragma once
struct Linked {
  void Three();
};
