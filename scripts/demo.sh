#!/usr/bin/env bash
# Builds the library and renders every sample program through it (with the host's Mesa as
# the vendor) and, for comparison, on Mesa directly. The images go to out/demo/.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
build="${OVO_BUILD_DIR:-$root/build}"
out="$root/out/demo"
bash "$root/scripts/build.sh"
mkdir -p "$out"
export EGL_PLATFORM=surfaceless
status=0
for program in "$build"/examples/*_ovo; do
  sample="$(basename "$program" _ovo)"
  # The library's Android log lines (standard error on a host) go to a file of their own.
  "$program" "$out/$sample.png" >/dev/null 2>"$out/$sample.log"
  "$build/examples/${sample}_mesa" "$out/${sample}_mesa.png" >/dev/null
  if cmp -s "$out/$sample.png" "$out/${sample}_mesa.png"; then
    echo "$sample: out/demo/$sample.png (identical to Mesa's own rendering)"
  else
    echo "$sample: out/demo/$sample.png DIFFERS from out/demo/${sample}_mesa.png"
    status=1
  fi
done
exit $status
