#!/usr/bin/env bash
# Soak test, not part of the test suite: every stereo sample draws 10,000 frames through the
# library with its profile installed, as the companion application installs one. The
# library's vendor is the counting stand-in of tools/gl-object-count: Mesa, with the live
# programs, shaders, textures, framebuffers, renderbuffers and buffers counted below the
# library and, every 500th swap, a line with them and the process's resident memory. From
# the first line (frame 500, after the start-up frames) to the last, no kind of object may
# grow, and the resident memory by no more than the slack below. Files go to out/soak/
# (NAME.count: the stand-in's lines, NAME.log: the library's log); exits non-zero when a run
# fails.
set -euo pipefail

frames=10000
# llvmpipe holds transient blocks of about 1 MB at some swaps and not at others: the
# readings of one run, frames 500 to 9,500, lay up to 2,884 kB apart in the runs measured
# (see "Soak" in README.md), while the library made no heap allocation after frame 500.
# The last reading also holds the sample's copy of its last frame, read before that swap:
# width x height x 4 bytes on top.
rss_noise_kb=4096

root="$(cd "$(dirname "$0")/.." && pwd)"
build="${OVO_BUILD_DIR:-$root/build}"
out="$root/out/soak"
bash "$root/scripts/install-deps.sh"
cmake -S "$root" -B "$build" -DCMAKE_BUILD_TYPE=RelWithDebInfo >/dev/null
cmake --build "$build" -j"$(nproc)" --target GLES_ovo_count ovo-profile es1_scene_ovo \
  es1_sprites_ovo es2_scene_ovo
rm -rf "$out"
mkdir -p "$out"
export EGL_PLATFORM=surfaceless

profile_tool="$build/tools/ovo-profile/ovo-profile"
library_dir="$build/gl-object-count"
installed_profile="$build/gl-object-count-device/sdcard/stereoconv/game/stereo_gm.ovo"
mkdir -p "$(dirname "$installed_profile")"
status=0

# reading FILE SWAP FIELD: FIELD's value in FILE's line for SWAP.
reading() {
  awk -v swap="$2" -v field="$3" \
    '$2 == swap { for (i = 3; i < NF; i += 2) if ($i == field) print $(i + 1) }' "$1"
}

# soak NAME SAMPLE PROFILE_TEXT PROCESS_NAME WIDTHxHEIGHT [OPTION...]: SAMPLE at that size
# through the counting library with the profile, under PROCESS_NAME (empty: the program's
# path), checked.
soak() {
  local name="$1" sample="$2" text="$3" process="$4" size="$5"
  shift 5
  local program="$build/examples/${sample}_ovo" count="$out/$name.count"
  local width="${size%x*}" height="${size#*x}"
  local rss_slack_kb=$((rss_noise_kb + width * height * 4 / 1024))
  process="${process:-$program}"
  "$profile_tool" write "$root/$text" -o "$installed_profile"
  local started=$SECONDS
  if ! LD_LIBRARY_PATH="$library_dir" OVO_GL_COUNT="$count" \
      bash -c 'exec -a "$0" "$@"' "$process" "$program" "$out/$name.png" --frames "$frames" \
      --size "$size" "$@" >/dev/null 2>"$out/$name.log"; then
    echo "  $name: the sample FAILED (out/soak/$name.log)"
    status=1
    return
  fi
  local seconds=$((SECONDS - started))
  if [ -e "$installed_profile" ]; then
    echo "  $name: FAILED, the library did not take the profile"
    status=1
    return
  fi
  local first=500 last="$frames" verdict="" kind
  local rss_first rss_last
  rss_first="$(reading "$count" $first rss_kb)"
  rss_last="$(reading "$count" "$last" rss_kb)"
  if [ -z "$rss_first" ] || [ -z "$rss_last" ] || [ "$rss_first" -lt 0 ]; then
    echo "  $name: FAILED, no readings for frames $first and $last in out/soak/$name.count"
    status=1
    return
  fi
  local objects_first="" objects_last="" total=0 at_first at_last
  for kind in programs shaders textures framebuffers renderbuffers buffers; do
    at_first="$(reading "$count" $first $kind)"
    at_last="$(reading "$count" "$last" $kind)"
    objects_first+=" $kind $at_first"
    objects_last+=" $kind $at_last"
    total=$((total + at_first))
    [ "$at_last" -le "$at_first" ] || verdict+=" $kind grew from $at_first to $at_last;"
  done
  # Every sample keeps textures: a count of none means the stand-in saw nothing.
  [ "$total" -gt 0 ] || verdict+=" no GL objects counted;"
  [ $((rss_last - rss_first)) -le $rss_slack_kb ] ||
    verdict+=" resident memory grew by $((rss_last - rss_first)) kB;"
  local as=""
  [ "$process" = "$program" ] || as=" as $process"
  echo "  $name ($sample$as, $size${*:+ $*}): $frames frames in $seconds s"
  echo "    resident memory: $rss_first kB at frame $first, $rss_last kB at frame $last" \
    "(at most +$rss_slack_kb kB)"
  echo "    GL objects at frame $first:$objects_first"
  echo "    GL objects at frame $last:$objects_last"
  if [ -n "$verdict" ]; then
    echo "    FAILED:$verdict"
    status=1
  fi
}

echo "Each sample $frames frames through the library with its profile:"
started=$SECONDS
soak es1_scene_interleave es1_scene examples/profiles/es1_scene_interleave.txt "" 320x240
soak es1_scene_overlay es1_scene examples/profiles/es1_scene_overlay.txt "" 1280x720
soak es1_sprites_listed es1_sprites examples/profiles/es1_sprites_listed.txt \
  com.rovio.angrybirds 320x240
soak es2_scene_interleave es2_scene examples/profiles/es2_scene_interleave.txt "" 320x240
soak es2_scene_tracked es2_scene examples/profiles/es2_scene_tracked.txt com.vectorunit.green \
  320x240
soak es1_scene_plain es1_scene tests/e2e/profiles/es1_scene_plain.txt "" 640x480 \
  --game-size 320x240
soak es2_scene_plain es2_scene tests/e2e/profiles/es2_scene_plain.txt "" 640x480 \
  --game-size 320x240
rm -f "$installed_profile"
echo "All runs: $((SECONDS - started)) s"
exit $status
