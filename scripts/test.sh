#!/usr/bin/env bash
# Builds zor2check and runs every test. With --sanitize, builds into build-asan/
# with AddressSanitizer and UndefinedBehaviorSanitizer and runs the same tests there.
set -euo pipefail
cd "$(dirname "$0")/.."

bash scripts/setup.sh

build_dir=build
cmake_args=(-DCMAKE_BUILD_TYPE=Release)
if [ "${1:-}" = "--sanitize" ]; then
  build_dir=build-asan
  cmake_args=(-DCMAKE_BUILD_TYPE=Debug -DZOR2_SANITIZE=ON)
fi

cmake -S . -B "$build_dir" "${cmake_args[@]}" >/dev/null
cmake --build "$build_dir" -j "$(nproc)"
ctest --test-dir "$build_dir" --output-on-failure -j "$(nproc)"
