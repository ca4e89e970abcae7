#include "driver/ComparisonRun.h"

int main(int argc, char** argv) {
  return static_cast<int>(RunProgram(argc, argv));
}
