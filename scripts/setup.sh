#!/usr/bin/env bash
# Installs the Debian packages the build needs, when they are missing (libclang-dev for
# zor2describe). With --package, also what CPack needs to make the Debian packages (file and
# dpkg-shlibdeps find the programs' shared-library dependencies); with --test, that and what
# the tests need besides (a JSON Schema validator, a Markdown renderer, Chromium, a YAML
# parser, groff); with --fuzz, clang and its runtimes (sanitizers, libFuzzer) for the fuzz
# target.
# Idempotent; run as root on Debian 12.
set -euo pipefail

packages=(cmake g++ make libgtest-dev libclang-dev)
if [ "${1:-}" = "--package" ] || [ "${1:-}" = "--test" ]; then
  packages+=(file dpkg-dev)
fi
if [ "${1:-}" = "--test" ]; then
  # The export tests: schema validation, Markdown rendering, the HTML page in a browser; the
  # CI recipes' YAML and the manual pages.
  packages+=(python3 python3-jsonschema cmark-gfm chromium python3-yaml groff-base)
fi
if [ "${1:-}" = "--fuzz" ]; then
  packages+=(clang libclang-rt-14-dev)
fi
missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
if [ ${#missing[@]} -eq 0 ]; then
  exit 0
fi
if [ "$(id -u)" -ne 0 ]; then
  echo "setup: missing packages: ${missing[*]}; run this script as root to install them" >&2
  exit 1
fi
export DEBIAN_FRONTEND=noninteractive
apt-get update -qq
apt-get install -y -qq --no-install-recommends "${missing[@]}"
