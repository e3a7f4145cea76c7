# shellcheck shell=bash disable=SC2153
# Service rows of bench/run.sh (sourced; uses its BUILD_DIR, SERVICE_BIN, WORK, PIDS, DURATION, REPEATS,
# CONNECTIONS, fail and record). Starts the configuration-service, one bare responder per answer
# and etcd, all on 127.0.0.1 under $WORK; measures Retrieve, Store and ListItems with wrk and the
# service's resident memory idle and after a burst of 1 MiB retrieves.

SERVICE_PATH="/Sundrel/ConfigurationService/ConfigurationService.ashx"
TICKET="bench-$RANDOM$RANDOM"

free_port() { python3 -c 'import socket; s=socket.socket(); s.bind(("127.0.0.1",0)); print(s.getsockname()[1])'; }

wait_for() {  # wait_for DESCRIPTION COMMAND...: up to 20 s
  local what="$1"; shift
  for _ in $(seq 200); do "$@" >/dev/null 2>&1 && return 0; sleep 0.1; done
  fail "$what did not come up"
}

start_service() {
  (umask 077; printf '%s' "$TICKET" >"$WORK/ticket")
  QUORVEX_SERVICE_TICKET_FILE="$WORK/ticket" "$SERVICE_BIN" \
    --port 0 --port-file "$WORK/service.port" --store-dir "$WORK/store" \
    --event-dir "$WORK/events" --host-name BenchHost --log-level error &
  SERVICE_PID=$!
  PIDS+=("$SERVICE_PID")
  wait_for "configuration-service" test -s "$WORK/service.port"
  SERVICE_URL="http://127.0.0.1:$(cat "$WORK/service.port")$SERVICE_PATH"
}

start_etcd() {
  local port peer
  port="$(free_port)"
  peer="$(free_port)"
  etcd --name bench --data-dir "$WORK/etcd" --max-request-bytes 16777216 \
    --listen-client-urls "http://127.0.0.1:$port" --advertise-client-urls "http://127.0.0.1:$port" \
    --listen-peer-urls "http://127.0.0.1:$peer" --initial-advertise-peer-urls "http://127.0.0.1:$peer" \
    --initial-cluster "bench=http://127.0.0.1:$peer" --log-level error >"$WORK/etcd.log" 2>&1 &
  PIDS+=($!)
  ETCD_URL="http://127.0.0.1:$port"
  wait_for "etcd" curl -sf "$ETCD_URL/health"
}

# start_bare NAME BODYFILE: a bare responder answering BODYFILE; its URL in BARE_URL[NAME].
declare -A BARE_URL=()
start_bare() {
  # As many socket threads as the service runs by default: on a machine shared with the load
  # generator, the thread count decides the share of the cores as much as the code does.
  "$BUILD_DIR/bench/bare_responder" --body "$2" --port-file "$WORK/bare-$1.port" --threads 4 &
  PIDS+=($!)
  wait_for "bare responder $1" test -s "$WORK/bare-$1.port"
  BARE_URL[$1]="http://127.0.0.1:$(cat "$WORK/bare-$1.port")$SERVICE_PATH"
}

post() {  # post URL BODYFILE OUTFILE: fails unless the answer is 2xx
  curl -sf -H "Cookie: OrvelWebApplication=$TICKET" -H "Content-Type: text/xml" \
    --data-binary "@$2" -o "$3" "$1" || fail "POST to $1 with $(basename "$2") failed"
}

expect() {  # expect FILE PATTERN
  grep -q "$2" "$1" || { head -c 400 "$1" >&2; fail "$(basename "$1") lacks $2"; }
}

# Payloads: the same random document for the service and etcd, at each size.
make_payloads() {
  python3 - "$WORK" <<'PY'
import base64, json, os, sys
work = sys.argv[1]
for label, size in (("1k", 1024), ("4k", 4096), ("64k", 65536), ("1m", 1 << 20)):
    data = base64.b64encode(os.urandom(size)).decode()
    name = "Bench\\Document" + label
    key = base64.b64encode(name.encode()).decode()
    bodies = {
        "store": "<Store><Host>BenchHost</Host><ConfigurationName>%s</ConfigurationName>"
                 "<Configuration>%s</Configuration></Store>" % (name, data),
        "retrieve": "<Retrieve><Host>BenchHost</Host><ConfigurationName>%s</ConfigurationName>"
                    "</Retrieve>" % name,
        "etcd-store": json.dumps({"key": key, "value": data}),
        "etcd-retrieve": json.dumps({"key": key}),
    }
    for kind, body in bodies.items():
        with open(os.path.join(work, "%s-%s.body" % (kind, label)), "w") as f:
            f.write(body)
for count in (1000, 10000):
    with open(os.path.join(work, "list-%d.body" % count), "w") as f:
        f.write("<ListItems><Host>List%d</Host></ListItems>" % count)
PY
}

# Stores COUNT small documents under host ListCOUNT over 8 kept-alive connections.
seed_list() {
  python3 - "$SERVICE_URL" "$TICKET" "$1" <<'PY'
import http.client, sys, threading, urllib.parse
url, ticket, count = urllib.parse.urlparse(sys.argv[1]), sys.argv[2], int(sys.argv[3])
errors = []
def worker(first, step):
    conn = http.client.HTTPConnection(url.hostname, url.port, timeout=30)
    for i in range(first, count, step):
        body = ("<Store><Host>List%d</Host><ConfigurationName>BrimmetServer\\Item%05d"
                "</ConfigurationName><Configuration>AAECAwQ=</Configuration></Store>" % (count, i))
        conn.request("POST", url.path, body, {"Cookie": "OrvelWebApplication=" + ticket})
        answer = conn.getresponse().read()
        if b"<ReturnStatus>1</ReturnStatus>" not in answer:
            errors.append(answer[:200])
            return
threads = [threading.Thread(target=worker, args=(k, 8)) for k in range(8)]
for t in threads: t.start()
for t in threads: t.join()
sys.exit("seeding failed: %r" % errors[0] if errors else 0)
PY
}

rss_kib() { awk '/^VmRSS:/ { print $2 }' "/proc/$1/status"; }

# Runs wrk once; records "wrk CASE/SERVER rps|p50ms VALUE".
# measure CASE SERVER URL BODYFILE CONNECTIONS CONTENT_TYPE
measure() {
  local lua="$WORK/run.lua" out="$WORK/wrk.out" threads=2
  [ "$5" -lt 2 ] && threads=1
  cat >"$lua" <<LUA
wrk.method = "POST"
local f = io.open("$4", "rb"); wrk.body = f:read("*a"); f:close()
wrk.headers["Content-Type"] = "$6"
wrk.headers["Cookie"] = "OrvelWebApplication=$TICKET"
LUA
  wrk -t"$threads" -c"$5" -d"${DURATION}s" --latency -s "$lua" "$3" >"$out" 2>&1 ||
    { cat "$out" >&2; fail "wrk failed against $2 ($1)"; }
  if grep -qE "Socket errors|Non-2xx" "$out"; then
    cat "$out" >&2
    fail "errors during $1 against $2"
  fi
  awk -v key="$1/$2" '
    function ms(v) { if (v ~ /us$/) return v / 1000; if (v ~ /ms$/) return v + 0; if (v ~ /s$/) return v * 1000; return v }
    /Requests\/sec:/ { rps = $2 }
    $1 == "50%" { p50 = ms($2) }
    END { if (rps == "" || p50 == "") exit 1; printf "wrk\t%s/rps\t%s\nwrk\t%s/p50ms\t%s\n", key, rps, key, p50 }' \
    "$out" >>"$RESULTS" || { cat "$out" >&2; fail "no figures from wrk for $1 against $2"; }
}

compact_etcd() {
  local rev
  rev="$(curl -sf -X POST -d '{"key":"AA=="}' "$ETCD_URL/v3/kv/range" |
    python3 -c 'import json,sys; print(json.load(sys.stdin)["header"]["revision"])')"
  curl -sf -X POST -d "{\"revision\":\"$rev\",\"physical\":true}" "$ETCD_URL/v3/kv/compaction" >/dev/null || true
  curl -sf -X POST -d '{}' "$ETCD_URL/v3/maintenance/defragment" >/dev/null || true
}

# One case against each of its servers, in the order rotated by the repeat number.
# run_case REPEAT CASE CONNECTIONS OURS_BODY BARE_NAME ETCD_PATH ETCD_BODY (- for none)
run_case() {
  local servers=(ours bare) server i
  [ "$6" != - ] && servers+=(etcd)
  for ((i = 0; i < ${#servers[@]}; i++)); do
    server="${servers[$(((i + $1) % ${#servers[@]}))]}"
    case "$server" in
      ours) measure "$2" ours "$SERVICE_URL" "$4" "$3" text/xml
        if [ "$2" = "retrieve-1m-c$CONNECTIONS" ]; then
          sleep 2
          record mem "after/$1" "$(rss_kib "$SERVICE_PID")"
        fi ;;
      bare) measure "$2" bare "${BARE_URL[$5]}" "$4" "$3" text/xml ;;
      etcd) [ "$6" = /v3/kv/put ] && compact_etcd
        measure "$2" etcd "$ETCD_URL$6" "$7" "$3" application/json ;;
    esac
  done
}

run_service_rows() {
  local label count r
  start_service
  start_etcd
  make_payloads
  echo "seeding the service and etcd ..." >&2
  for label in 1k 4k 64k 1m; do
    post "$SERVICE_URL" "$WORK/store-$label.body" "$WORK/stored-$label.out"
    expect "$WORK/stored-$label.out" "<ReturnStatus>1</ReturnStatus>"
    post "$SERVICE_URL" "$WORK/retrieve-$label.body" "$WORK/answer-$label.xml"
    expect "$WORK/answer-$label.xml" "<Configuration>"
    curl -sf -X POST --data-binary "@$WORK/etcd-store-$label.body" "$ETCD_URL/v3/kv/put" \
      -o "$WORK/etcd-put.out" || fail "etcd put $label failed"
    curl -sf -X POST --data-binary "@$WORK/etcd-retrieve-$label.body" "$ETCD_URL/v3/kv/range" \
      -o "$WORK/etcd-range.out" || fail "etcd range $label failed"
    expect "$WORK/etcd-range.out" '"value"'
    start_bare "retrieve-$label" "$WORK/answer-$label.xml"
  done
  start_bare store "$WORK/stored-4k.out"
  for count in 1000 10000; do
    seed_list "$count" || fail "seeding $count documents failed"
    post "$SERVICE_URL" "$WORK/list-$count.body" "$WORK/list-$count.xml"
    [ "$(grep -o '<ConfigurationItem>' "$WORK/list-$count.xml" | wc -l)" = "$count" ] ||
      fail "ListItems did not list $count documents"
    record count "list-$count" "$count"
    start_bare "list-$count" "$WORK/list-$count.xml"
  done
  sleep 2
  record mem idle "$(rss_kib "$SERVICE_PID")"
  echo "measuring the service rows ($REPEATS repeats, ${DURATION}s per run) ..." >&2
  for ((r = 0; r < REPEATS; r++)); do
    for label in 1k 4k 64k 1m; do
      run_case "$r" "retrieve-$label-c$CONNECTIONS" "$CONNECTIONS" "$WORK/retrieve-$label.body" \
        "retrieve-$label" /v3/kv/range "$WORK/etcd-retrieve-$label.body"
    done
    run_case "$r" retrieve-1m-c1 1 "$WORK/retrieve-1m.body" retrieve-1m /v3/kv/range \
      "$WORK/etcd-retrieve-1m.body"
    run_case "$r" "store-4k-c$CONNECTIONS" "$CONNECTIONS" "$WORK/store-4k.body" store \
      /v3/kv/put "$WORK/etcd-store-4k.body"
    for count in 1000 10000; do
      run_case "$r" "list-$count-c1" 1 "$WORK/list-$count.body" "list-$count" - -
    done
  done
  record meta connections "$CONNECTIONS"
}
