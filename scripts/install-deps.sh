#!/usr/bin/env bash
# Installs what building and testing need on Debian 12, and nothing when it is all there.
set -euo pipefail
packages=(g++ cmake make python3 binutils pkg-config libpng-dev patchelf
  libgtest-dev libbenchmark-dev
  libegl-dev libgles-dev libegl-mesa0 libgl1-mesa-dri
  # The third-party programs in stereo and their X server.
  glmark2-es2-x11 mesa-utils libsdl2-tests xvfb x11-xserver-utils
  # The OpenGL ES 1.x program taken out of the piglit package needs these beside it.
  libwaffle-1-0 libgl1 libxkbcommon0
  # ovo-tune's preview window and its font; its tests press keys and take screenshots.
  libsdl2-dev libsdl2-ttf-dev fonts-dejavu-core xdotool imagemagick)
# Installed for this machine's architecture (or for all): on a machine that also holds
# another architecture's copy (scripts/armhf.sh), an unqualified name is ambiguous to dpkg.
native="$(dpkg --print-architecture)"
missing=()
for package in "${packages[@]}"; do
  dpkg-query -W -f='${Architecture} ${db:Status-Abbrev}\n' "$package" 2>/dev/null |
    grep -Eq "^($native|all) ii" || missing+=("$package")
done
sudo_cmd=""
[ "$(id -u)" -eq 0 ] || sudo_cmd="sudo"
if [ ${#missing[@]} -gt 0 ]; then
  echo "installing: ${missing[*]}"
  $sudo_cmd apt-get update -qq
  DEBIAN_FRONTEND=noninteractive $sudo_cmd apt-get install -y -qq "${missing[@]}"
fi
# The piglit corpus test fetches the piglit package's .deb itself (not installed:
# scripts/fetch-piglit-corpus.sh), for which apt must know the package.
if ! apt-cache show piglit >/dev/null 2>&1; then
  echo "apt knows no piglit package: updating the package lists"
  $sudo_cmd apt-get update -qq || echo "install-deps: apt-get update failed; the piglit corpus test will fail"
fi
