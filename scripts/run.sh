#!/usr/bin/env bash
# The main job: installs what is missing, builds, and starts this machine's configuration service
# on 127.0.0.1 with its store under ./run, stores and reads back the machine's system
# configuration through the library, and prints how to use configctl against the service. The
# service runs in the foreground until Ctrl-C.
#   PORT=8771 scripts/run.sh
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
cd "$root"
"$root/scripts/install-deps.sh"
"$root/scripts/build.sh" "$root/build" -DQUORVEX_BENCH=OFF

port=${PORT:-8771}
run="$root/run"
mkdir -p "$run/events"
if [ ! -s "$run/service-ticket" ]; then
  (umask 077 && openssl rand -hex 32 >"$run/service-ticket")
fi
chmod 600 "$run/service-ticket"
export QUORVEX_SERVICE_TICKET_FILE="$run/service-ticket"
export QUORVEX_EVENT_DIR="$run/events"
export QUORVEX_CONFIGURATION_SERVER="127.0.0.1:$port"

bin="$root/build"
"$bin/service/configuration-service" --bind 127.0.0.1 --port "$port" --store-dir "$run/store" \
  --event-dir "$run/events" &
service=$!
trap 'kill -TERM $service 2>/dev/null; wait $service 2>/dev/null' EXIT INT TERM

ctl="$bin/tools/configctl --server 127.0.0.1:$port"
for _ in $(seq 1 100); do
  $ctl hosts >/dev/null 2>&1 && break
  sleep 0.1
done

echo "== storing this machine's system configuration through the library"
"$bin/examples/store_system_configuration" "/var/log/quorvex" "corbaloc::127.0.0.1:2809/Stack"
echo "== reading it back through the library"
"$bin/examples/read_system_configuration"

host=$($ctl whoami 2>/dev/null | head -n 1 | awk "{print \$NF}" || hostname -s)
cat <<USAGE

The configuration service is listening on 127.0.0.1:$port (store: $run/store).
Try, in another shell (same environment: export QUORVEX_SERVICE_TICKET_FILE=$run/service-ticket):
  $ctl hosts
  $ctl items --host '*'
  $ctl get --host $host 'BrimmetServer\\OrvelSystem'
  $ctl --help
Press Ctrl-C to stop the service.
USAGE
wait $service
