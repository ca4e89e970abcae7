#!/usr/bin/env bash
# Builds the Debian packages under build/ with CPack: zor2check_VERSION_ARCH.deb (the checker,
# its manual page, the documentation and the CMake package) and zor2describe_VERSION_ARCH.deb
# (the describer, which needs libclang). Installs what is missing first (run as root on
# Debian 12). Install the packages with
#   apt-get install ./build/zor2check_*.deb ./build/zor2describe_*.deb
set -euo pipefail
cd "$(dirname "$0")/.."

bash scripts/setup.sh --package
cmake -S . -B build -DCMAKE_BUILD_TYPE=Release >/dev/null
cmake --build build -j "$(nproc)"
(cd build && cpack -G DEB)
