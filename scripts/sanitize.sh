#!/usr/bin/env bash
# Builds and tests under the sanitizers, each build in a folder of its own beside the
# normal one (build-asan and build-tsan next to build/ or $OVO_BUILD_DIR):
#   scripts/sanitize.sh address   everything under AddressSanitizer and
#                                 UndefinedBehaviorSanitizer, then the whole test suite
#   scripts/sanitize.sh thread    the tests that start threads, under ThreadSanitizer
#   scripts/sanitize.sh           both
# Every finding fails its test. What is suppressed (other libraries' own, never ours) is
# listed with its reason in tests/sanitizers/tsan.supp and lsan.supp.
set -euo pipefail
root="$(cd "$(dirname "$0")/.." && pwd)"
build="${OVO_BUILD_DIR:-$root/build}"
build_root="$(dirname "$build")"
thread_suppressions="$root/tests/sanitizers/tsan.supp"
leak_suppressions="$root/tests/sanitizers/lsan.supp"
kinds=("$@")
[ ${#kinds[@]} -gt 0 ] || kinds=(address thread)
bash "$root/scripts/install-deps.sh"

# The tests that start threads of their own: the targets that hold them and their names.
thread_targets=(threads_recording_tests threads_mesa_tests core_tests)
thread_tests='Threads'

# The piglit corpus is fetched once, into the normal build tree.
configure() {
  cmake -S "$root" -B "$1" -DCMAKE_BUILD_TYPE=RelWithDebInfo -DOVO_SANITIZE="$2" \
    -DOVO_PIGLIT_DIR="$build/piglit" "${@:3}" >/dev/null
}

for kind in "${kinds[@]}"; do
  case "$kind" in
    address)
      dir="${OVO_ASAN_BUILD_DIR:-$build_root/build-asan}"
      # The leak check's tracer dies (signal 11) reading the thread-local storage that Mesa's
      # OpenGL ES 2.0 path allocates through __tls_get_addr; not intercepting that call
      # keeps the tracer away from it.
      export ASAN_OPTIONS="detect_leaks=1:check_initialization_order=1:strict_init_order=1"
      export ASAN_OPTIONS="$ASAN_OPTIONS:intercept_tls_get_addr=0"
      export UBSAN_OPTIONS="print_stacktrace=1:halt_on_error=1"
      export LSAN_OPTIONS="suppressions=$leak_suppressions"
      configure "$dir" address,undefined
      cmake --build "$dir" -j"$(nproc)"
      # Mesa's driver stays loaded to the leak check (see keep_libraries_loaded.cpp). The
      # preload also reaches programs that are not ours (cmake, bash), which is harmless;
      # in ours it comes before the sanitizer's runtime, which must then allow that.
      # Debian's programs (label third-party) are not built with the sanitizer and cannot
      # load an instrumented library; they run in the normal build only.
      (cd "$dir" &&
        ASAN_OPTIONS="$ASAN_OPTIONS:verify_asan_link_order=0" \
        LD_PRELOAD="$dir/tests/sanitizers/libovo_keep_libraries_loaded.so" \
        ctest -j"$(nproc)" --output-on-failure -LE third-party)
      ;;
    thread)
      dir="${OVO_TSAN_BUILD_DIR:-$build_root/build-tsan}"
      export TSAN_OPTIONS="halt_on_error=1:suppressions=$thread_suppressions"
      configure "$dir" thread -DOVO_BUILD_EXAMPLES=OFF -DOVO_BUILD_BENCHMARKS=OFF
      cmake --build "$dir" -j"$(nproc)" --target "${thread_targets[@]}"
      (cd "$dir" && ctest -j"$(nproc)" --output-on-failure -R "$thread_tests")
      ;;
    *)
      echo "sanitize.sh: unknown sanitizer '$kind' (address or thread)" >&2
      exit 2
      ;;
  esac
done
