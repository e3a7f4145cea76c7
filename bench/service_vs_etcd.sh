#!/usr/bin/env bash
# Loopback benchmark: configuration-service against etcd's HTTP/JSON gateway under wrk, with the
# same payloads. "Retrieve" is compared with a range get and "Store" with a put, for 4 KiB and
# 64 KiB documents, with keep-alive and with a new connection per request. Both answer a write only
# after it is on disk (our store fsyncs the item and its directory; etcd fsyncs its log).
#
# Usage: bench/service_vs_etcd.sh [SECONDS_PER_RUN]   (default 5)
# Environment: BUILD_DIR (default ./build; the service is built there if missing),
#              CONNECTIONS (default 16), THREADS (wrk threads, default 2).
set -euo pipefail

ROOT="$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)"
DURATION="${1:-5}"
CONNECTIONS="${CONNECTIONS:-16}"
THREADS="${THREADS:-2}"
BUILD_DIR="${BUILD_DIR:-$ROOT/build}"
SERVICE="$BUILD_DIR/service/configuration-service"
SERVICE_PATH="/Sundrel/ConfigurationService/ConfigurationService.ashx"

for tool in wrk etcd python3 curl; do
  command -v "$tool" >/dev/null || { echo "service_vs_etcd: $tool is missing (scripts/install-deps.sh)" >&2; exit 1; }
done
if [ ! -x "$SERVICE" ]; then
  cmake -S "$ROOT" -B "$BUILD_DIR" -DCMAKE_BUILD_TYPE=RelWithDebInfo >/dev/null
  cmake --build "$BUILD_DIR" -j2 --target configuration-service ServerInterop >/dev/null
fi

WORK="$(mktemp -d "${TMPDIR:-/tmp}/service-vs-etcd.XXXXXX")"
SERVICE_PID=""
ETCD_PID=""
cleanup() {
  [ -n "$SERVICE_PID" ] && kill "$SERVICE_PID" 2>/dev/null && wait "$SERVICE_PID" 2>/dev/null
  [ -n "$ETCD_PID" ] && kill "$ETCD_PID" 2>/dev/null && wait "$ETCD_PID" 2>/dev/null
  rm -rf "$WORK"
}
trap cleanup EXIT

free_port() { python3 -c 'import socket; s=socket.socket(); s.bind(("127.0.0.1",0)); print(s.getsockname()[1])'; }

wait_for() {  # wait_for DESCRIPTION COMMAND...: up to 10 s
  local what="$1"; shift
  for _ in $(seq 100); do "$@" >/dev/null 2>&1 && return 0; sleep 0.1; done
  echo "service_vs_etcd: $what did not come up" >&2; exit 1
}

# --- the two servers -------------------------------------------------------------------------
TICKET="bench-$RANDOM$RANDOM"
(umask 077; printf '%s' "$TICKET" > "$WORK/ticket")
export QUORVEX_SERVICE_TICKET_FILE="$WORK/ticket"
"$SERVICE" --port 0 --port-file "$WORK/service.port" --store-dir "$WORK/store" \
  --event-dir "$WORK/events" --host-name BenchHost --log-level error --threads 64 &
SERVICE_PID=$!
wait_for "configuration-service" test -s "$WORK/service.port"
SERVICE_URL="http://127.0.0.1:$(cat "$WORK/service.port")$SERVICE_PATH"

ETCD_PORT="$(free_port)"
PEER_PORT="$(free_port)"
etcd --name bench --data-dir "$WORK/etcd" \
  --listen-client-urls "http://127.0.0.1:$ETCD_PORT" --advertise-client-urls "http://127.0.0.1:$ETCD_PORT" \
  --listen-peer-urls "http://127.0.0.1:$PEER_PORT" --initial-advertise-peer-urls "http://127.0.0.1:$PEER_PORT" \
  --initial-cluster "bench=http://127.0.0.1:$PEER_PORT" --log-level error >"$WORK/etcd.log" 2>&1 &
ETCD_PID=$!
ETCD_URL="http://127.0.0.1:$ETCD_PORT"
wait_for "etcd" curl -sf "$ETCD_URL/health"

# --- payloads: the same random bytes for both ------------------------------------------------
python3 - "$WORK" <<'PY'
import base64, json, os, sys
work = sys.argv[1]
for size in (4, 64):
    data = base64.b64encode(os.urandom(size * 1024)).decode()
    name = "Bench\\Document%d" % size
    key = base64.b64encode(name.encode()).decode()
    files = {
        "ours-store": "<Store><Host>BenchHost</Host><ConfigurationName>%s</ConfigurationName>"
                      "<Configuration>%s</Configuration></Store>" % (name, data),
        "ours-retrieve": "<Retrieve><Host>BenchHost</Host><ConfigurationName>%s</ConfigurationName>"
                         "</Retrieve>" % name,
        "etcd-store": json.dumps({"key": key, "value": data}),
        "etcd-retrieve": json.dumps({"key": key}),
    }
    for kind, body in files.items():
        with open(os.path.join(work, "%s-%d.body" % (kind, size)), "w") as f:
            f.write(body)
PY

write_lua() {  # write_lua BODYFILE CLOSE(0/1) EXTRA_HEADER > script
  cat <<LUA
wrk.method = "POST"
local f = io.open("$1", "rb"); wrk.body = f:read("*a"); f:close()
wrk.headers["Content-Type"] = "$3"
wrk.headers["Cookie"] = "OrvelWebApplication=$TICKET"
$( [ "$2" = 1 ] && echo 'wrk.headers["Connection"] = "close"' )
LUA
}

# Checks one request of a kind answers success before it is measured.
check() {  # check URL BODYFILE PATTERN
  curl -s -H "Cookie: OrvelWebApplication=$TICKET" --data-binary "@$2" "$1" > "$WORK/check.out" || true
  grep -q "$3" "$WORK/check.out" ||
    { echo "service_vs_etcd: $1 did not answer $3:" >&2; head -c 500 "$WORK/check.out" >&2; exit 1; }
}

compact_etcd() {
  local rev
  rev="$(curl -sf -X POST -d '{"key":"AA=="}' "$ETCD_URL/v3/kv/range" |
         python3 -c 'import json,sys; print(json.load(sys.stdin)["header"]["revision"])')"
  curl -sf -X POST -d "{\"revision\":\"$rev\",\"physical\":true}" "$ETCD_URL/v3/kv/compaction" >/dev/null || true
  curl -sf -X POST -d '{}' "$ETCD_URL/v3/maintenance/defragment" >/dev/null || true
}

# Prints "req/s p50ms p99ms" from one wrk run.
measure() {  # measure URL BODYFILE CLOSE CONTENT_TYPE
  write_lua "$2" "$3" "$4" > "$WORK/run.lua"
  wrk -t"$THREADS" -c"$CONNECTIONS" -d"${DURATION}s" --latency -s "$WORK/run.lua" "$1" > "$WORK/wrk.out" 2>&1
  if grep -q "Non-2xx" "$WORK/wrk.out"; then
    echo "service_vs_etcd: errors during the run against $1:" >&2; cat "$WORK/wrk.out" >&2; exit 1
  fi
  awk '
    function ms(v) { if (v ~ /us$/) return v / 1000; if (v ~ /ms$/) return v + 0; if (v ~ /s$/) return v * 1000; return v }
    /Requests\/sec:/ { rps = $2 }
    $1 == "50%" { p50 = ms($2) }
    $1 == "99%" { p99 = ms($2) }
    END { printf "%.0f %.2f %.2f\n", rps, p50, p99 }' "$WORK/wrk.out"
}

# Seed both stores so that retrieves find the documents.
for size in 4 64; do
  check "$SERVICE_URL" "$WORK/ours-store-$size.body" "<ReturnStatus>1</ReturnStatus>"
  check "$ETCD_URL/v3/kv/put" "$WORK/etcd-store-$size.body" "revision"
  check "$SERVICE_URL" "$WORK/ours-retrieve-$size.body" "<Configuration>"
  check "$ETCD_URL/v3/kv/range" "$WORK/etcd-retrieve-$size.body" '"value"'
done

printf "\n%-9s %-5s %-10s | %10s %8s %8s | %10s %8s %8s | %6s\n" \
  "operation" "size" "connection" "ours req/s" "p50 ms" "p99 ms" "etcd req/s" "p50 ms" "p99 ms" "ratio"
printf '%.0s-' $(seq 100); echo
for op in Retrieve Store; do
  kind="$(echo "$op" | tr 'A-Z' 'a-z')"
  etcd_path="/v3/kv/range"; [ "$op" = Store ] && etcd_path="/v3/kv/put"
  for size in 4 64; do
    for close in 0 1; do
      conn="keep-alive"; [ "$close" = 1 ] && conn="close"
      read -r o_rps o_p50 o_p99 < <(measure "$SERVICE_URL" "$WORK/ours-$kind-$size.body" "$close" "text/xml")
      compact_etcd
      read -r e_rps e_p50 e_p99 < <(measure "$ETCD_URL$etcd_path" "$WORK/etcd-$kind-$size.body" "$close" "application/json")
      ratio="$(awk -v a="$o_rps" -v b="$e_rps" 'BEGIN { if (b > 0) printf "%.2f", a / b; else print "n/a" }')"
      printf "%-9s %-5s %-10s | %10s %8s %8s | %10s %8s %8s | %6s\n" \
        "$op" "${size}KiB" "$conn" "$o_rps" "$o_p50" "$o_p99" "$e_rps" "$e_p50" "$e_p99" "$ratio"
    done
  done
done
echo "($CONNECTIONS connections, $THREADS wrk threads, ${DURATION}s per run, loopback; ratio = ours/etcd req/s)"
