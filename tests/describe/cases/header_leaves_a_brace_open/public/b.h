#pragma once
struct Open {
  void Two();
