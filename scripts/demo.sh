#!/usr/bin/env bash
# Builds the library and renders every sample program through it (with the host's Mesa as
# the vendor) and, for comparison, on Mesa directly. Then renders samples again with each
# example stereo profile installed, as the companion application installs one before a
# game starts. The images go to out/demo/.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
build="${OVO_BUILD_DIR:-$root/build}"
out="$root/out/demo"
bash "$root/scripts/build.sh"
rm -rf "$out"
mkdir -p "$out"
export EGL_PLATFORM=surfaceless
status=0

echo "Without a profile every call passes through unchanged:"
for program in "$build"/examples/*_ovo; do
  sample="$(basename "$program" _ovo)"
  # The library's Android log lines (standard error on a host) go to a file of their own.
  "$program" "$out/$sample.png" >/dev/null 2>"$out/$sample.log"
  "$build/examples/${sample}_mesa" "$out/${sample}_mesa.png" >/dev/null
  if cmp -s "$out/$sample.png" "$out/${sample}_mesa.png"; then
    echo "  $sample: out/demo/$sample.png (identical to Mesa's own rendering)"
  else
    echo "  $sample: out/demo/$sample.png DIFFERS from out/demo/${sample}_mesa.png"
    status=1
  fi
done

# The library's device root, where the profile, the version report and the panel's nodes
# live on a host.
device="$(sed -n 's/^OVO_DEVICE_ROOT:[A-Z]*=//p' "$build/CMakeCache.txt")"
profile_tool="$build/tools/ovo-profile/ovo-profile"
echo "With an example profile (examples/profiles), as the library reads it:"
for pair in column_interleave:es2_scene side_by_side_plain:es1_scene top_bottom_plain:es1_sprites; do
  profile="${pair%%:*}"
  sample="${pair##*:}"
  program="$build/examples/${sample}_ovo"
  mode="$("$profile_tool" show "$build/profiles/$profile.ovo" --process "$program" | sed -n 's/^mode = //p')"
  mkdir -p "$device/sdcard/stereoconv/game" "$device/sdcard/duoscope" "$device/dev"
  cp "$build/profiles/$profile.ovo" "$device/sdcard/stereoconv/game/stereo_gm.ovo"
  rm -f "$device/sdcard/duoscope/version.txt"
  : >"$device/dev/zpx"
  image="$out/$sample.$profile.png"
  # Enough frames for the panel refresh, which runs on processor time, to come round.
  LD_PRELOAD="$build/src/platform/libovo_panel_driver.so" \
    "$program" "$image" --frames 60 >/dev/null 2>"$out/$sample.$profile.log"
  report="$(sed -n 's/^\t//p' "$device/sdcard/duoscope/version.txt" 2>/dev/null | tail -n 1)"
  landscape="$(grep -c 'argument=1$' "$device/dev/zpx" || true)"
  portrait="$(grep -c 'argument=2$' "$device/dev/zpx" || true)"
  consumed="kept"
  [ -e "$device/sdcard/stereoconv/game/stereo_gm.ovo" ] || consumed="deleted at eglGetDisplay"
  echo "  $profile with $sample: mode $mode; profile file $consumed;" \
    "version report: ${report:-none}; panel requests: $landscape 3D landscape, $portrait 3D portrait;" \
    "out/demo/$sample.$profile.png"
done
exit $status
