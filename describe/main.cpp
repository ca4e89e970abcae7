#include <iostream>

#include "describe/describe_run.h"

int main(int argc, char** argv) {
  return static_cast<int>(zor2::describe::RunDescribe(argc, argv, std::cout, std::cerr));
}
