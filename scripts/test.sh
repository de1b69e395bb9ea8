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

# --- 32-bit ARM (armhf), the device's ABI: the same tests built for it and run under
# qemu-arm (scripts/armhf.sh; about 18 minutes on 2 cores). On amd64 machines only;
# OVO_SKIP_ARMHF=1 leaves it out. A failing armhf run fails this script.
if [ "$(dpkg --print-architecture)" = amd64 ] && [ "${OVO_SKIP_ARMHF:-0}" != 1 ]; then
  bash "$root/scripts/armhf.sh"
fi
