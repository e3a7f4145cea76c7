#!/usr/bin/env bash
# Installs what is missing, builds, and runs every test: the normal build, then the whole suite
# again under AddressSanitizer + UndefinedBehaviorSanitizer, then every test binary labelled
# "threads" (those with multi-threaded tests) under ThreadSanitizer. Warnings are errors.
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

run_suite "$root/build" -DQUORVEX_BENCH=ON -DQUORVEX_WERROR=ON
ASAN_OPTIONS=detect_leaks=1:abort_on_error=1 UBSAN_OPTIONS=print_stacktrace=1 \
  run_suite "$root/build-asan" -DQUORVEX_SANITIZE=ON -DQUORVEX_BENCH=OFF -DQUORVEX_WERROR=ON

echo "=== ThreadSanitizer: the multi-threaded suites"
"$root/scripts/build.sh" "$root/build-tsan" -DQUORVEX_TSAN=ON -DQUORVEX_BENCH=OFF -DQUORVEX_WERROR=ON
(cd "$root/build-tsan" && TSAN_OPTIONS=halt_on_error=1 \
  ctest --output-on-failure -j"$(nproc)" --timeout 300 -L threads)
echo "=== all test suites passed"
