// Café: a comment in Latin-1, and a tag value that is no UTF-8.
#pragma once

class Menu {
 public:
  /// @ZOR2Property é
  void Order(const char* dish = "crème brûlée");
};
