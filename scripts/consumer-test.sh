#!/usr/bin/env bash
# Installs a build tree into a staging prefix and checks what a consumer gets: versioned libraries
# with only the exported API visible, headers under include/quorvex, then two out-of-tree
# programs (one through the CMake package, one through pkg-config) that store and read a
# document through the repository from the staged configuration-service on 127.0.0.1.
#   scripts/consumer-test.sh [BUILD_DIR]   (default: build; configctl, configuration-service and
#                                          the libraries must be built there)
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
build=$(cd "${1:-$root/build}" && pwd)
work=$(mktemp -d /tmp/configuration-consumer.XXXXXX)
stage="$work/stage"
service=""
cleanup() {
  if [ -n "$service" ]; then kill -TERM "$service" 2>/dev/null || true; wait "$service" 2>/dev/null || true; fi
  rm -rf "$work"
}
trap cleanup EXIT
fail() { echo "consumer-test: $*" >&2; exit 1; }

echo "=== install into $stage"
cmake --install "$build" --prefix "$stage" >"$work/install.log"
lib="$stage/lib"
for l in Configuration Vesk QuorvexCommon; do
  soname=$(readelf -d "$lib/lib$l.so" | sed -n 's/.*(SONAME).*\[\(.*\)\]/\1/p')
  [ "$soname" = "lib$l.so.0" ] || fail "lib$l.so has SONAME '$soname'"
done
[ -f "$lib/libServerInterop.so" ] || fail "libServerInterop.so is not beside libConfiguration.so"
nm -DC --defined-only "$lib/libConfiguration.so" >"$work/symbols"
grep -q 'ConfigurationRepository::instance' "$work/symbols" || fail "the repository is not exported"
if grep -q 'DirectoryStore' "$work/symbols"; then fail "internal symbols (DirectoryStore) are exported"; fi
[ -f "$stage/include/quorvex/Configuration/ConfigurationRepository.h" ] || fail "headers missing"
[ -x "$stage/bin/configctl" ] && [ -x "$stage/sbin/configuration-service" ] || fail "programs missing"

echo "=== build the consumers"
cp -r "$root/packaging/consumer" "$work/cmake"
cp -r "$root/packaging/consumer" "$work/pkgconfig"
cmake -S "$work/cmake" -B "$work/cmake/build" -DCMAKE_PREFIX_PATH="$stage" >"$work/cmake.log" ||
  { cat "$work/cmake.log"; fail "find_package(Configuration) failed"; }
cmake --build "$work/cmake/build" >>"$work/cmake.log" || { cat "$work/cmake.log"; fail "CMake consumer"; }
PKG_CONFIG_PATH="$lib/pkgconfig" make -s -C "$work/pkgconfig" consumer || fail "pkg-config consumer"
for c in "$work/cmake/build/consumer" "$work/pkgconfig/consumer"; do
  ldd "$c" >"$work/ldd"
  grep -q "$lib/libConfiguration.so.0" "$work/ldd" || fail "$c does not load the staged library"
done

echo "=== run them against the staged service"
mkdir -p "$work/events"
(umask 077 && head -c 32 /dev/urandom | od -An -tx1 | tr -d ' \n' >"$work/ticket")
export QUORVEX_SERVICE_TICKET_FILE="$work/ticket" QUORVEX_EVENT_DIR="$work/events"
"$stage/sbin/configuration-service" --bind 127.0.0.1 --port 0 \
  --port-file "$work/port" --store-dir "$work/store" --event-dir "$work/events" \
  --log-level warning &
service=$!
for _ in $(seq 1 100); do [ -s "$work/port" ] && break; sleep 0.1; done
[ -s "$work/port" ] || fail "the staged service did not start"
export QUORVEX_CONFIGURATION_SERVER="127.0.0.1:$(cat "$work/port")"

roundtrip() {
  local writer=$1 reader=$2 marker=$3
  # The first store logs that nothing is stored yet; the log is shown only on failure.
  "$writer" store "$marker" 2>"$work/store.log" || { cat "$work/store.log"; fail "$writer could not store"; }
  local got
  got=$("$reader" read) || fail "$reader could not read"
  [ "$got" = "$marker" ] || fail "$reader read '$got', expected '$marker'"
}
roundtrip "$work/cmake/build/consumer" "$work/pkgconfig/consumer" "/var/log/cmake-$$"
roundtrip "$work/pkgconfig/consumer" "$work/cmake/build/consumer" "/var/log/pkgconfig-$$"
echo "=== consumer test passed"
