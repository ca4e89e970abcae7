#pragma once
struct First {
  void One();
};
