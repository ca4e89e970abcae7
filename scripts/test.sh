#!/usr/bin/env bash
# Builds zor2check and runs every test. With --sanitize, builds into build-asan/
# with AddressSanitizer and UndefinedBehaviorSanitizer and runs the same tests there.
# With --fuzz, builds the fuzz target with clang into build-fuzz/ and runs it once
# over its seed corpus (fuzz/corpus/): seconds, not a fuzzing session.
set -euo pipefail
cd "$(dirname "$0")/.."

# CI treats warnings as errors.
werror=()
[ -n "${CI:-}" ] && werror=(-DZOR2_WERROR=ON)

if [ "${1:-}" = "--fuzz" ]; then
  bash scripts/setup.sh --fuzz
  cmake -S . -B build-fuzz -DCMAKE_CXX_COMPILER=clang++ -DCMAKE_BUILD_TYPE=RelWithDebInfo \
    -DZOR2_FUZZ=ON -DBUILD_TESTING=OFF "${werror[@]}" >/dev/null
  cmake --build build-fuzz -j "$(nproc)" --target check_fuzzer
  # -close_fd_mask=2 keeps the checker's warnings out of libFuzzer's output.
  build-fuzz/check_fuzzer -close_fd_mask=2 fuzz/corpus/*
  exit 0
fi

bash scripts/setup.sh --test

build_dir=build
cmake_args=(-DCMAKE_BUILD_TYPE=Release)
if [ "${1:-}" = "--sanitize" ]; then
  build_dir=build-asan
  cmake_args=(-DCMAKE_BUILD_TYPE=Debug -DZOR2_SANITIZE=ON)
fi

cmake -S . -B "$build_dir" "${cmake_args[@]}" "${werror[@]}" >/dev/null
cmake --build "$build_dir" -j "$(nproc)"
ctest --test-dir "$build_dir" --output-on-failure -j "$(nproc)"
