#pragma once
struct Last {
  void Three();
};
