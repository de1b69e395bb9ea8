#!/usr/bin/env bash
# Cross-builds the library, its tests and tools for 32-bit ARM (armhf, the device's ABI)
# into build-armhf/ (or $OVO_ARMHF_BUILD_DIR) with Debian's cross toolchain, and runs the
# tests under qemu-arm:
#   - every test that needs no GPU (recording vendor, scenario processes, configuration,
#     presentation, stereo layers, shader rewriter, tools, exports, fuzz corpora);
#   - with Mesa's armhf libraries, tests on Mesa (llvmpipe under the emulator, slow):
#     OVO_ARMHF_MESA=some (the default) the unit tests on Mesa and the samples' plain
#     renderings, =all every test on Mesa (the stereo frames and lifecycle scenarios too),
#     =none none.
# The groups are told apart by name: tests on Mesa match $mesa_tests, the subset
# $mesa_subset.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
build="${OVO_ARMHF_BUILD_DIR:-$root/build-armhf}"
mesa_choice="${OVO_ARMHF_MESA:-some}"
mesa_tests='^(EndToEnd|SwapCapture|Lifecycle)\.|OnMesa'
mesa_subset='OnMesa'
started=$SECONDS

sudo_cmd=""
[ "$(id -u)" -eq 0 ] || sudo_cmd="sudo"
apt_install() {
  DEBIAN_FRONTEND=noninteractive $sudo_cmd apt-get install -y -qq "$@"
}
# Installs the packages not yet installed; returns non-zero when apt cannot.
install_missing() {
  local missing=() package
  for package in "$@"; do
    dpkg -s "$package" >/dev/null 2>&1 || missing+=("$package")
  done
  [ ${#missing[@]} -eq 0 ] && return 0
  echo "installing: ${missing[*]}"
  apt_install "${missing[@]}" && return 0
  # Multiarch needs one version of a shared package for both architectures. A mirror whose
  # security index for armhf fails to load leaves amd64 ahead: take the release's versions
  # on both sides, and the kernel headers (the one package then older) at the armhf one.
  local headers release
  headers="$(apt-cache policy linux-libc-dev:armhf | sed -n 's/^ *Candidate: //p')"
  release="$(sed -n 's/^VERSION_CODENAME=//p' /etc/os-release)"
  echo "retrying with both architectures at the release's versions"
  apt_install -t "$release" --allow-downgrades \
    "linux-libc-dev:amd64=$headers" "linux-libc-dev:armhf=$headers" "${missing[@]}"
}

bash "$root/scripts/install-deps.sh"
if ! dpkg --print-foreign-architectures | grep -qx armhf; then
  $sudo_cmd dpkg --add-architecture armhf
  $sudo_cmd apt-get update -qq || true  # a lagging mirror index is handled below
fi
# Exit status 3: this machine cannot be given the toolchain or the emulator (its mirror, or
# a container without binfmt_misc); the caller decides whether that fails its run.
unavailable() {
  echo "armhf: $1; the armhf run did not take place" >&2
  exit 3
}
install_missing crossbuild-essential-armhf qemu-user qemu-user-binfmt \
  libgtest-dev:armhf libpng-dev:armhf libegl-dev:armhf libgles-dev:armhf ||
  unavailable "the cross toolchain and qemu could not be installed"
with_mesa=false
if [ "$mesa_choice" != none ] &&
   install_missing libegl-mesa0:armhf libgl1-mesa-dri:armhf libgles2:armhf libgles1:armhf; then
  with_mesa=true
fi

# The tests start ARM programs themselves (scenario processes re-run their own program,
# tool tests run the tools, the end-to-end scripts run the samples): the kernel hands ARM
# binaries to qemu-arm. Without systemd nothing registers the handler at boot.
binfmt=/proc/sys/fs/binfmt_misc
if [ ! -e "$binfmt/qemu-arm" ]; then
  mountpoint -q "$binfmt" || $sudo_cmd mount -t binfmt_misc binfmt_misc "$binfmt" ||
    unavailable "binfmt_misc cannot be mounted here"
  grep -v '^#' /usr/lib/binfmt.d/qemu-arm.conf | $sudo_cmd tee "$binfmt/register" >/dev/null ||
    unavailable "qemu-arm cannot be registered with binfmt_misc here"
fi

# The piglit corpus is fetched once, into the normal build tree.
cmake -S "$root" -B "$build" -DCMAKE_TOOLCHAIN_FILE="$root/cmake/armhf-toolchain.cmake" \
  -DCMAKE_BUILD_TYPE=RelWithDebInfo -DOVO_BUILD_BENCHMARKS=OFF \
  -DOVO_PIGLIT_DIR="${OVO_BUILD_DIR:-$root/build}/piglit" >/dev/null
cmake --build "$build" -j"$(nproc)"
built=$SECONDS

cd "$build"
export EGL_PLATFORM=surfaceless
status=0
echo "armhf: the tests that need no GPU, under qemu-arm"
# Debian's programs (label third-party) are this machine's, not armhf builds.
ctest -j"$(nproc)" -E "$mesa_tests" -LE third-party --output-on-failure || status=1
if $with_mesa; then
  selected="$mesa_subset"
  [ "$mesa_choice" = all ] && selected="$mesa_tests"
  echo "armhf: the tests on Mesa matching '$selected' (llvmpipe under qemu-arm)"
  ctest -j"$(nproc)" -R "$selected" -LE third-party --output-on-failure || status=1
else
  echo "armhf: the tests on Mesa did not run (OVO_ARMHF_MESA=none or Mesa's armhf libraries missing)"
fi
echo "armhf: built in $((built - started)) s, tested in $((SECONDS - built)) s"
exit $status
