#!/usr/bin/env bash
# Builds zor2check and checks the example workspaces, the checked workspace against the
# reference one, directory mode, with -L: first the plain run (build/examples-report.xml and
# the help page build/examples-help.htm), then the run a CI pipeline makes, which accepts the
# findings listed in examples/baseline.xml, exports the findings and fails on the others
# (build/examples-ci-report.xml, build/examples-findings.{html,md,json,sarif}).
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

echo
echo "--- the same check as a CI gate, with a baseline and the exports"
ci_status=0
build/zor2check -r examples/reference -c examples/checked -o build/examples-ci-report.xml \
  -L -level M4R20 -fail -baseline examples/baseline.xml \
  -export build/examples-findings.html -export build/examples-findings.md \
  -export build/examples-findings.json -export build/examples-findings.sarif || ci_status=$?
echo
echo "exit status: $ci_status (3: findings that the baseline does not accept)"
echo "readable:    build/examples-findings.html, build/examples-findings.md"
echo "for tools:   build/examples-findings.json, build/examples-findings.sarif"
echo
cat build/examples-findings.md
exit "$status"
