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

# The whole suite once more under AddressSanitizer and UndefinedBehaviorSanitizer, and the
# tests that start threads under ThreadSanitizer (scripts/sanitize.sh).
bash "$root/scripts/sanitize.sh"

# --- 32-bit ARM (armhf), the device's ABI: the same tests built for it and run under
# qemu-arm (scripts/armhf.sh; 3 to 18 minutes on 2 cores, by how busy they are). On amd64
# machines only; OVO_SKIP_ARMHF=1 leaves it out. A failing armhf run fails this script.
if [ "$(dpkg --print-architecture)" = amd64 ] && [ "${OVO_SKIP_ARMHF:-0}" != 1 ]; then
  armhf_status=0
  bash "$root/scripts/armhf.sh" || armhf_status=$?
  # 3: the machine could not be given the cross toolchain; that is said loudly, and only a
  # failing armhf build or test fails this script.
  if [ "$armhf_status" -eq 3 ]; then
    echo "test.sh: NOTE: the armhf run did not take place on this machine (see above)"
  elif [ "$armhf_status" -ne 0 ]; then
    exit "$armhf_status"
  fi
fi
