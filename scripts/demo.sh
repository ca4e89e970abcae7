#!/usr/bin/env bash
# Builds zor2check and checks the example workspaces: the checked workspace against
# the reference one, directory mode, with -L. Writes build/examples-report.xml and
# build/examples-help.htm.
set -euo pipefail
cd "$(dirname "$0")/.."

bash scripts/setup.sh
cmake -S . -B build -DCMAKE_BUILD_TYPE=Release >/dev/null
cmake --build build -j "$(nproc)" --target zor2check

status=0
build/zor2check -r examples/reference -c examples/checked -o build/examples-report.xml \
  -L -level M4R20 -htm build/examples-help.htm || status=$?
echo
echo "exit status: $status"
echo "report:      build/examples-report.xml"
echo "help page:   build/examples-help.htm"
echo
cat build/examples-report.xml
exit "$status"
