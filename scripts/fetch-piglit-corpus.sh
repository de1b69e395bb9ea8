#!/usr/bin/env bash
# Puts the vertex shaders that the depth-shift corpus test compiles below DIR (the build
# tree's piglit/ unless configured otherwise), and the one OpenGL ES 1.x program that the
# third-party tests run with the libraries it needs: Debian's piglit package is fetched once
# with `apt-get download` (about 34 MB, kept in DIR) and only the GLSL ES 1.00 tests, the
# other .vert files and that program are taken out of it, never the 2 GB the package
# installs.
#   scripts/fetch-piglit-corpus.sh DIR
# Does nothing when DIR already holds the extract. Fails, saying why, when the package
# cannot be had; the corpus test then fails too.
set -euo pipefail
dir="${1:?usage: fetch-piglit-corpus.sh DIR}"
stamp="$dir/extracted-shader-tests"
[ -e "$stamp" ] && exit 0

fail() {
  echo "fetch-piglit-corpus: $*" >&2
  echo "fetch-piglit-corpus: the piglit corpus test cannot run without it and fails" >&2
  exit 1
}

mkdir -p "$dir"
partial=""
extract=""
trap 'rm -rf "$partial" "$extract"' EXIT
debs=("$dir"/piglit_*.deb)
if [ ! -e "${debs[0]}" ]; then
  echo "fetch-piglit-corpus: fetching the piglit package (about 34 MB) into $dir"
  # Fetched beside the cache and moved in whole, so that an interrupted download is not
  # taken for the package next time.
  partial="$(mktemp -d "$dir/download.XXXXXX")"
  (cd "$partial" && apt-get download piglit) ||
    fail "'apt-get download piglit' failed (no network, or apt knows no piglit package: run 'apt-get update' as root, or bash scripts/install-deps.sh)"
  mv "$partial"/piglit_*.deb "$dir/"
  debs=("$dir"/piglit_*.deb)
fi

extract="$(mktemp -d "$dir/extract.XXXXXX")"
# piglit keeps its shader tests in one folder below tests/, glsl-es-1.00 among them; the
# .vert files of the other folders are taken too, and left with the extract.
dpkg-deb --fsys-tarfile "${debs[0]}" |
  tar -x -C "$extract" --wildcards './usr/lib/*/piglit/tests/*.vert' \
    './usr/lib/*/piglit/tests/*/glsl-es-1.00/*' './usr/lib/*/piglit/bin/arb_point_sprite-checkerboard_gles1' \
    './usr/lib/*/piglit/lib/libpiglitutil.so*' './usr/lib/*/piglit/lib/libpiglitutil_gles1.so*' ||
  fail "could not extract the shaders and the program from ${debs[0]} (delete it to fetch it again)"
piglit=("$extract"/usr/lib/*/piglit)
es_100=("${piglit[0]}"/tests/*/glsl-es-1.00)
[ -d "${es_100[0]}" ] || fail "${debs[0]} holds no glsl-es-1.00 folder below tests/"
[ -x "${piglit[0]}/bin/arb_point_sprite-checkerboard_gles1" ] || fail "${debs[0]} holds no arb_point_sprite-checkerboard_gles1"
rm -rf "$dir/tests" "$dir/shader-tests" "$dir/bin" "$dir/lib"
mv "$(dirname "${es_100[0]}")" "$dir/shader-tests"
mv "${piglit[0]}/bin" "${piglit[0]}/lib" "$dir/"
touch "$stamp"
echo "fetch-piglit-corpus: extracted $(find "$dir/shader-tests" -type f | wc -l) files into $dir/shader-tests"
