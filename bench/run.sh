#!/usr/bin/env bash
# bench/run.sh: builds the benchmarks and prints one table of our figures next to the limits
# measured in the same run (a bare HTTP responder sending the same bytes, bare zlib + pugixml, a
# bare libcurl loop, ...), their ratio, the goal and whether it is met; etcd beside the service
# rows. Service rows are wrk runs (keep-alive) against the real configuration-service, the bare
# responder and etcd, in an order that rotates across repeats; each figure is the median of
# REPEATS runs. Library rows pair Google Benchmark results by name (table below).
#
# Usage: bench/run.sh [--service-only | --library-only]
# Environment: BUILD_DIR (default ./build-bench), DURATION (seconds per wrk run, default 3),
#              REPEATS (default 3), CONNECTIONS (default 16), KEEP_WORK=1 (keep the work folder),
#              SERVICE_BIN (the service to measure, default the one built here; e.g. an older
#              build to compare), SKIP_BUILD=1 (use what BUILD_DIR holds).
# Exits 0 when every measurement ran (whether or not each goal is met), non-zero on any failure.
set -euo pipefail

# --- library rows: edit here when a benchmark is renamed ---------------------------------------
# lib_row FIGURE BINARY OURS LIMIT KIND GOAL
#   KIND time: ratio = our time / limit time, met when <= GOAL
#        rate: ratio = our calls per second / the limit's, met when >= GOAL (all threads)
#        ns:   our time alone in ns per call, met when <= GOAL; LIMIT (or -) is shown beside it
# Names are Google Benchmark's run names without "/real_time" and "/iterations:N" (e.g.
# "BM_X/threads:2", "ClientRetrieve/65536"); each binary runs REPEATS times, medians are used.
LIB_ROWS=()
lib_row() { LIB_ROWS+=("$(printf '%s\t%s\t%s\t%s\t%s\t%s' "$@")"); }
lib_row "stored-form decode, 1 MB" stored_form_bench BM_DecodeStoredForm BM_DecodeBareZlibPugixml time 1.4
lib_row "stored-form encode, level 9" stored_form_bench BM_EncodeStoredForm BM_EncodeBarePugixmlZlib time 1.1
lib_row "cold GetLatest" repository_bench BM_ColdGetLatest BM_BareClientRetrieve time 1.4
lib_row "cold GetLatest vs its two requests bare" repository_bench BM_ColdGetLatest BM_BareTimestampAndRetrieve time 1.4
lib_row "cached GetLatest, 2 threads vs 1" repository_bench BM_CachedGetLatest/threads:2 BM_CachedGetLatest/threads:1 rate 1.6
lib_row "machine: private loop, 2 threads vs 1" repository_bench BM_BareThreadScaling/threads:2 BM_BareThreadScaling/threads:1 rate 1.6
lib_row "cached GetLatest, 1 thread (ns)" repository_bench BM_CachedGetLatest/threads:1 - ns 100
lib_row "client Retrieve 64 KiB" http_client_bench ClientRetrieve/65536 BareCurlRetrieve/65536 rate 0.95
lib_row "client Retrieve 64 KiB vs bare libcurl + Base64 decode" http_client_bench ClientRetrieve/65536 BareCurlRetrieveAndDecode/65536 rate 0.95

ROOT="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
BUILD_DIR="${BUILD_DIR:-$ROOT/build-bench}"
DURATION="${DURATION:-3}"
REPEATS="${REPEATS:-3}"
CONNECTIONS="${CONNECTIONS:-16}"
MODE="${1:-all}"
case "$MODE" in all | --service-only | --library-only) ;; *)
  echo "usage: bench/run.sh [--service-only | --library-only]" >&2; exit 2 ;;
esac

fail() { echo "bench/run.sh: $*" >&2; exit 1; }
for tool in wrk etcd python3 curl cmake; do
  command -v "$tool" >/dev/null || fail "$tool is missing (scripts/install-deps.sh)"
done

WORK="$(mktemp -d "${TMPDIR:-/tmp}/quorvex-bench.XXXXXX")"
PIDS=()
cleanup() {
  local pid
  for pid in "${PIDS[@]}"; do kill "$pid" 2>/dev/null || true; done
  for pid in "${PIDS[@]}"; do wait "$pid" 2>/dev/null || true; done
  if [ "${KEEP_WORK:-0}" = 1 ]; then echo "work folder kept: $WORK" >&2; else rm -rf "$WORK"; fi
}
trap cleanup EXIT
trap 'exit 130' INT TERM

# --- build ---------------------------------------------------------------------------------------
build() {
  echo "building the benchmarks in $BUILD_DIR ..." >&2
  cmake -S "$ROOT" -B "$BUILD_DIR" -DCMAKE_BUILD_TYPE=RelWithDebInfo -DQUORVEX_BENCH=ON \
    >"$WORK/configure.log" 2>&1 || { cat "$WORK/configure.log" >&2; fail "configure failed"; }
  TARGETS=(configuration-service ServerInterop bare_responder)
  for row in "${LIB_ROWS[@]}"; do TARGETS+=("$(cut -f2 <<<"$row")"); done
  mapfile -t TARGETS < <(printf '%s\n' "${TARGETS[@]}" | sort -u)
  nice -n 10 cmake --build "$BUILD_DIR" -j"$(nproc)" --target "${TARGETS[@]}" \
    >"$WORK/build.log" 2>&1 || { tail -40 "$WORK/build.log" >&2; fail "build failed"; }
}
[ "${SKIP_BUILD:-0}" = 1 ] || build
SERVICE_BIN="${SERVICE_BIN:-$BUILD_DIR/service/configuration-service}"

RESULTS="$WORK/results.tsv"  # kind \t key \t value, read by bench/run_table.py
: >"$RESULTS"
record() { printf '%s\t%s\t%s\n' "$@" >>"$RESULTS"; }

if [ "$MODE" != --library-only ]; then
  # shellcheck source=bench/service_rows.sh
  source "$ROOT/bench/service_rows.sh"
  run_service_rows
fi

if [ "$MODE" != --service-only ]; then
  declare -A RAN=()
  for row in "${LIB_ROWS[@]}"; do
    binary="$(cut -f2 <<<"$row")"
    [ -n "${RAN[$binary]:-}" ] && continue
    RAN[$binary]=1
    echo "running $binary ..." >&2
    "$BUILD_DIR/bench/$binary" --benchmark_out="$WORK/$binary.json" --benchmark_out_format=json \
      --benchmark_repetitions="$REPEATS" --benchmark_report_aggregates_only=true \
      >"$WORK/$binary.out" 2>&1 || { cat "$WORK/$binary.out" >&2; fail "$binary failed"; }
    record json "$binary" "$WORK/$binary.json"
  done
  for row in "${LIB_ROWS[@]}"; do record lib_row "$row" -; done
fi

python3 "$ROOT/bench/run_table.py" "$RESULTS"
