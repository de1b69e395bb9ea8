#!/usr/bin/env bash
# Builds the library and renders every sample program through it (with the host's Mesa as
# the vendor) and, for comparison, on Mesa directly. Then renders every sample with every
# example stereo profile installed, as the companion application installs one before a
# game starts, through a copy of the library whose vendor EGL writes out the frame at each
# swap, exactly as the panel receives it. An interleaved frame is also shown side by side
# and as a red-cyan anaglyph. The images go to out/demo/.
set -euo pipefail

# The columns eye 0 lands on: how Mesa (llvmpipe) rasterises the lines of the stencil mask,
# measured there (the frame at the swap is the samples' own eye renderings interleaved so).
eye0_columns=even
# Processor time per run with a profile: the panel refresh comes round every 0.1 s of it.
cpu_seconds=1.0
# profile -> the one sample it is made for; a profile not named here goes with every sample.
# The third-party profile goes with a program that is not a sample (the last part below).
declare -A profile_sample=([es1_scene_interleave]=es1_scene [es1_scene_overlay]=es1_scene
  [es1_sprites_listed]=es1_sprites [es2_scene_interleave]=es2_scene
  [es2_scene_tracked]=es2_scene [third_party_800x480]=glmark2)
# A program nobody here wrote: glmark2's build scene, at the size of the third-party profile.
glmark2_frames=60
# profile -> the options its sample needs with it.
declare -A profile_options=([es1_scene_overlay]="--size 1280x720")
# profile -> the process name its sample runs under (else the program's path): the library
# draws sprites per eye for listed games only, and tracks render textures for one game.
declare -A profile_process=([es1_sprites_listed]=com.rovio.angrybirds
  [es2_scene_tracked]=com.vectorunit.green)

root="$(cd "$(dirname "$0")/.." && pwd)"
build="${OVO_BUILD_DIR:-$root/build}"
out="$root/out/demo"
bash "$root/scripts/build.sh"
rm -rf "$out"
mkdir -p "$out"
export EGL_PLATFORM=surfaceless
status=0

profile_tool="$build/tools/ovo-profile/ovo-profile"
frames_tool="$build/tools/ovo-frames/ovo-frames"
panel_driver="$build/src/platform/libovo_panel_driver.so"
# The library whose vendor EGL is the swap-capture shim, and its device root, where the
# profile, the version report and the panel's nodes live.
capture_library="$build/capture/GLES_ovo_capture"
device="$build/capture-device"
installed_profile="$device/sdcard/stereoconv/game/stereo_gm.ovo"
mkdir -p "$device/sdcard/stereoconv/game" "$device/sdcard/duoscope" "$device/dev"

# run_captured PROCESS_NAME PROGRAM IMAGE RAW LOG [OPTION...]: PROGRAM under PROCESS_NAME
# through the capture library, the panel driver stand-in loaded; RAW gets the last swap.
run_captured() {
  local name="$1" program="$2" image="$3" raw="$4" log="$5"
  shift 5
  LD_LIBRARY_PATH="$capture_library" LD_PRELOAD="$panel_driver" OVO_SWAP_CAPTURE="$raw" \
    bash -c 'exec -a "$0" "$@"' "$name" "$program" "$image" "$@" >/dev/null 2>"$log"
}

echo "Without a profile every call passes through unchanged:"
rm -f "$installed_profile"
for program in "$build"/examples/*_ovo; do
  sample="$(basename "$program" _ovo)"
  # The lifecycle programs play the tests' scenarios; they are no samples to show.
  [[ "$sample" != lifecycle_* ]] || continue
  # The library's Android log lines (standard error on a host) go to a file of their own.
  "$program" "$out/$sample.png" >/dev/null 2>"$out/$sample.log"
  "$build/examples/${sample}_mesa" "$out/${sample}_mesa.png" >/dev/null
  if cmp -s "$out/$sample.png" "$out/${sample}_mesa.png"; then
    echo "  $sample: out/demo/$sample.png (identical to Mesa's own rendering)"
  else
    echo "  $sample: out/demo/$sample.png DIFFERS from out/demo/${sample}_mesa.png"
    status=1
  fi
  # The frame at the vendor's swap is the one the sample read just before it.
  if run_captured "$program" "$program" "$out/$sample.own.png" "$out/$sample.raw.png" \
      "$out/$sample.raw.log" &&
     "$frames_tool" compare "$out/$sample.raw.png" "$out/$sample.own.png" >"$out/$sample.compare" 2>&1; then
    echo "    captured at the swap: out/demo/$sample.raw.png (identical to the sample's own frame)"
  else
    echo "    captured at the swap: out/demo/$sample.raw.png DIFFERS: $(cat "$out/$sample.compare")"
    status=1
  fi
done

# Long enough by processor time for the panel refresh to come round; samples without
# --cpu-seconds draw a fixed number of frames instead.
run_length() {
  local usage
  usage="$("$1" 2>&1 || true)"
  if [[ "$usage" == *--cpu-seconds* ]]; then echo "--cpu-seconds $cpu_seconds"; else echo "--frames 60"; fi
}

echo "With each example profile (examples/profiles), through the capture library:"
for text in "$root"/examples/profiles/*.txt; do
  profile="$(basename "$text" .txt)"
  for program in "$build"/examples/*_ovo; do
    sample="$(basename "$program" _ovo)"
    [[ "$sample" != lifecycle_* ]] || continue
    if [ -n "${profile_sample[$profile]:-}" ] && [ "${profile_sample[$profile]}" != "$sample" ]; then
      continue
    fi
    name="${profile_process[$profile]:-$program}"
    if ! shown="$("$profile_tool" show "$build/profiles/$profile.ovo" --process "$name")"; then
      echo "  $profile: no binary profile in $build/profiles (configure again to pick it up)"
      status=1
      continue
    fi
    mode="$(sed -n 's/^mode = //p' <<<"$shown")"
    valid="$(sed -n 's/^valid = //p' <<<"$shown")"

    cp "$build/profiles/$profile.ovo" "$installed_profile"
    rm -f "$device/sdcard/duoscope/version.txt"
    : >"$device/dev/zpx"
    : >"$device/dev/zdriver"
    base="$sample.$profile"
    # shellcheck disable=SC2046,SC2086  # options of several words
    if ! run_captured "$name" "$program" "$out/$base.png" "$out/$base.raw.png" "$out/$base.log" \
        $(run_length "$program") ${profile_options[$profile]:-}; then
      echo "  $profile with $sample: the sample FAILED (out/demo/$base.log)"
      status=1
      continue
    fi
    files="out/demo/$base.png (the sample's own frame), out/demo/$base.raw.png (at the swap)"
    if [[ "$mode" == shader || "$mode" == shader_listed ]] && [ "$valid" = true ]; then
      for view in preview:sbs anaglyph:anaglyph; do
        if "$frames_tool" "${view%%:*}" "$out/$base.raw.png" --eye0-columns "$eye0_columns" \
            -o "$out/$base.${view##*:}.png"; then
          files+=", out/demo/$base.${view##*:}.png"
        else
          status=1
        fi
      done
    fi

    report="$(sed -n 's/^\t//p' "$device/sdcard/duoscope/version.txt" 2>/dev/null | tail -n 1)"
    landscape="$(grep -c 'request=0xc0047602 argument=1$' "$device/dev/zpx" || true)"
    portrait="$(grep -c 'request=0xc0047602 argument=2$' "$device/dev/zpx" || true)"
    composition="$(grep -c 'request=0x616 ' "$device/dev/zdriver" || true)"
    consumed="kept"
    [ -e "$installed_profile" ] || consumed="deleted at eglGetDisplay"
    as=""
    [ "$name" = "$program" ] || as=" (as $name)"
    echo "  $profile with $sample$as: mode $mode; profile file $consumed; version report: ${report:-none}"
    echo "    panel requests: /dev/zpx $landscape 3D landscape, $portrait 3D portrait;" \
      "/dev/zdriver $composition composition start"
    echo "    $files"
  done
done

echo "A program nobody here wrote, in stereo: glmark2-es2's build scene, through the capture library:"
# It opens libEGL.so.1 and libGLESv2.so.2 (or the unversioned names) itself: a folder of
# those names leads it to the library. It asks for a configuration without stencil unless
# told otherwise; the library gives every configuration one for the column mask.
libraries="$(mktemp -d)"
xvfb_pid=""
trap 'rm -rf "$libraries"; [ -z "$xvfb_pid" ] || kill "$xvfb_pid" 2>/dev/null' EXIT
for name in libEGL.so.1 libEGL.so libGLESv2.so.2 libGLESv2.so libGLESv1_CM.so.1 libGLESv1_CM.so; do
  ln -s "$capture_library/libGLES_ovo.so" "$libraries/$name"
done
# A private X server; it writes its display number once it takes clients.
Xvfb -displayfd 3 -screen 0 1024x768x24 -nolisten tcp 3>"$libraries/display" >/dev/null 2>&1 &
xvfb_pid=$!
for _ in $(seq 200); do [ -s "$libraries/display" ] && break; sleep 0.1; done
display_number="$(tr -d '\n' <"$libraries/display")"
base="glmark2_build.third_party_800x480"
if [ -z "$display_number" ]; then
  echo "  glmark2-es2: Xvfb did not start"
  status=1
else
  cp "$build/profiles/third_party_800x480.ovo" "$installed_profile"
  if DISPLAY=":$display_number" LD_LIBRARY_PATH="$libraries" OVO_SWAP_CAPTURE="$out/$base.raw.png" \
      glmark2-es2 -b "build:nframes=$glmark2_frames" --size 800x480 --visual-config stencil=8 \
      >"$out/$base.log" 2>&1; then
    files="out/demo/$base.raw.png (at the swap)"
    for view in preview:sbs anaglyph:anaglyph; do
      "$frames_tool" "${view%%:*}" "$out/$base.raw.png" --eye0-columns "$eye0_columns" \
        -o "$out/$base.${view##*:}.png" && files+=", out/demo/$base.${view##*:}.png" || status=1
    done
    echo "  $(grep -o '\[build\].*' "$out/$base.log" | head -n 1)"
    echo "    $files"
  else
    echo "  glmark2-es2 FAILED (out/demo/$base.log)"
    status=1
  fi
fi
rm -f "$installed_profile"
exit $status
