#!/usr/bin/env bash
# Installs what is missing, builds, and runs every test: the normal build, then the whole suite
# again under AddressSanitizer + UndefinedBehaviorSanitizer, then every test binary labelled
# "threads" (those with multi-threaded tests) under ThreadSanitizer, then the install checks
# (scripts/consumer-test.sh, scripts/package-test.sh). Warnings are errors.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
cd "$root"
"$root/scripts/install-deps.sh"

run_suite() {
  local dir=$1
  shift
  echo "=== build $dir"
  "$root/scripts/build.sh" "$dir" "$@"
  echo "=== test $dir"
  (cd "$dir" && ctest --output-on-failure -j"$(nproc)" --timeout 300)
}

# Line tables only (-g1): backtraces keep their file and line, the build takes a quarter less.
run_suite "$root/build" -DQUORVEX_BENCH=ON -DQUORVEX_WERROR=ON \
  -DCMAKE_CXX_FLAGS_RELWITHDEBINFO="-O2 -g1 -DNDEBUG"
ASAN_OPTIONS=detect_leaks=1:abort_on_error=1 UBSAN_OPTIONS=print_stacktrace=1 \
  run_suite "$root/build-asan" -DQUORVEX_SANITIZE=ON -DQUORVEX_BENCH=OFF -DQUORVEX_WERROR=ON

echo "=== ThreadSanitizer: the multi-threaded suites"
"$root/scripts/build.sh" "$root/build-tsan" -DQUORVEX_TSAN=ON -DQUORVEX_BENCH=OFF -DQUORVEX_WERROR=ON
(cd "$root/build-tsan" && TSAN_OPTIONS=halt_on_error=1 \
  ctest --output-on-failure -j"$(nproc)" --timeout 300 -L threads)
echo "=== installing: the staged install and its two consumers, then the Debian packages"
"$root/scripts/consumer-test.sh" "$root/build"
SUDO=""
if [ "$(id -u)" -ne 0 ]; then SUDO="sudo"; fi
$SUDO "$root/scripts/package-test.sh" "$root/build"
echo "=== all test suites passed"
