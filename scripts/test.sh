#!/usr/bin/env bash
# Builds everything and runs the whole test suite.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
build="${OVO_BUILD_DIR:-$root/build}"
bash "$root/scripts/build.sh"
# The fuzz corpora, once more under the sanitizers of a clang build.
bash "$root/scripts/fuzz.sh"
cd "$build"
ctest -j"$(nproc)" --output-on-failure
