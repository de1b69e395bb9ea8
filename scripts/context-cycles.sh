#!/usr/bin/env bash
# Context cycles: a game that makes a new context for every level while a shared loading
# context lives throughout (tests/e2e/context_cycles.cpp), run as the one tracked game with
# its profile, so that every context gets the library's eye textures and the share group
# the mask's program. The library's vendor is the counting stand-in of
# tools/gl-object-count: the live GL objects below the library and the resident memory,
# read at swaps spread over the run, may not grow from the first reading to the last.
#
#   bash scripts/context-cycles.sh [CYCLES]    # default 2,000; files in out/context-cycles/
#
# OVO_BUILD_DIR names the build tree (default build/); with OVO_NO_BUILD=1 it is used as
# built, as the test suite's short run does; OVO_CHECK_RESIDENT=0 leaves the resident
# memory unchecked (under the sanitizers). Exits non-zero when the run fails.
set -euo pipefail

cycles="${1:-2000}"
# llvmpipe holds transient blocks of about 1 MB at some swaps and not at others (see
# "Soak" in README.md).
rss_slack_kb=4096

root="$(cd "$(dirname "$0")/.." && pwd)"
build="${OVO_BUILD_DIR:-$root/build}"
out="${OVO_OUT_DIR:-$root/out/context-cycles}"
if [ "${OVO_NO_BUILD:-0}" != 1 ]; then
  cmake --build "$build" -j2 --target GLES_ovo_count ovo-profile context_cycles_ovo
fi
mkdir -p "$out"
count="$out/cycles-$cycles.count"
log="$out/cycles-$cycles.log"
rm -f "$count"

profile="$build/gl-object-count-device/sdcard/stereoconv/game/stereo_gm.ovo"
mkdir -p "$(dirname "$profile")"
"$build/tools/ovo-profile/ovo-profile" write "$root/examples/profiles/es2_scene_tracked.txt" \
  -o "$profile"
# Twenty readings, the first after the first twentieth of the run.
every=$(( cycles >= 20 ? cycles / 20 : 1 ))
started_ms=$(( $(date +%s%N) / 1000000 ))
if ! LD_LIBRARY_PATH="$build/gl-object-count" OVO_GL_COUNT="$count" OVO_GL_COUNT_EVERY="$every" \
    bash -c 'exec -a com.vectorunit.green "$0" "$@"' "$build/tests/e2e/context_cycles_ovo" \
    "$cycles" >/dev/null 2>"$log"; then
  echo "context cycles: the program FAILED ($log)"
  exit 1
fi
elapsed_ms=$(( $(date +%s%N) / 1000000 - started_ms ))
if [ -e "$profile" ]; then
  echo "context cycles: FAILED, the library did not take the profile"
  exit 1
fi

# field LINE NAME: NAME's value in a reading line.
field() { awk -v name="$2" '{ for (i = 3; i < NF; i += 2) if ($i == name) print $(i + 1) }' <<<"$1"; }
first="$(head -n 1 "$count")"
last="$(grep "^swap " "$count" | tail -n 1)"
verdict=""
kinds="programs shaders textures framebuffers renderbuffers buffers"
[ "${OVO_CHECK_RESIDENT:-1}" = 0 ] || kinds="rss_kb $kinds"
for kind in $kinds; do
  at_first="$(field "$first" "$kind")"
  at_last="$(field "$last" "$kind")"
  slack=0
  [ "$kind" != rss_kb ] || slack=$rss_slack_kb
  [ "$at_last" -le $((at_first + slack)) ] || verdict+=" $kind grew from $at_first to $at_last;"
done
# During a cycle the game's render texture and the level's two eye textures are alive.
[ "$(field "$first" textures)" -ge 3 ] || verdict+=" no eye textures counted;"
echo "context cycles: $cycles cycles in $((elapsed_ms / 1000)).$(printf '%03d' $((elapsed_ms % 1000))) s" \
  "($((elapsed_ms * 1000 / cycles)) us a cycle)"
echo "  first reading: $first"
echo "  last reading:  $last"
if [ -n "$verdict" ]; then
  echo "  FAILED:$verdict"
  exit 1
fi
