#include "driver/comparison_run.h"

int main(int argc, char** argv) {
  return static_cast<int>(zor2::RunProgram(argc, argv));
}
