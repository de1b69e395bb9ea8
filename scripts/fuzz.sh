#!/usr/bin/env bash
# Builds the fuzz targets with clang and libFuzzer (address and undefined-behaviour
# sanitizers) into build-fuzz/, then runs each one on a copy of its corpus.
#   scripts/fuzz.sh            replay the checked-in corpora once (what CI does)
#   scripts/fuzz.sh SECONDS    fuzz each target for SECONDS
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
build="${OVO_FUZZ_BUILD_DIR:-$root/build-fuzz}"
seconds="${1:-0}"
command -v clang++ >/dev/null && dpkg -s libclang-rt-14-dev >/dev/null 2>&1 || {
  sudo_cmd=""; [ "$(id -u)" -eq 0 ] || sudo_cmd="sudo"
  $sudo_cmd apt-get update -qq
  DEBIAN_FRONTEND=noninteractive $sudo_cmd apt-get install -y -qq clang libclang-rt-14-dev
}
CXX=clang++ cmake -S "$root" -B "$build" -DOVO_FUZZ=ON -DCMAKE_BUILD_TYPE=RelWithDebInfo \
  -DOVO_BUILD_TESTS=OFF -DOVO_BUILD_EXAMPLES=OFF -DOVO_BUILD_BENCHMARKS=OFF -DOVO_BUILD_TOOLS=OFF >/dev/null
targets=$(sed -n 's/^ovo_add_fuzz_target(\([a-z_]*\) .*corpus\/\([a-z_]*\)".*/\1:\2/p' "$root/fuzz/CMakeLists.txt")
for target in $targets; do
  cmake --build "$build" -j"$(nproc)" --target "${target%%:*}" >/dev/null
done
for target in $targets; do
  name="${target%%:*}"
  corpus="$root/fuzz/corpus/${target##*:}"
  if [ "$seconds" -eq 0 ]; then
    "$build/fuzz/$name" -runs=0 "$corpus" 2>&1 | tail -n 1
  else
    work="$(mktemp -d)"
    cp -r "$corpus/." "$work/"
    "$build/fuzz/$name" -max_total_time="$seconds" -timeout=10 "$work" 2>&1 | tail -n 2
    echo "$name: new inputs are in $work (copy the useful ones into $corpus)"
  fi
done
