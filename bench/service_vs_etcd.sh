#!/usr/bin/env bash
# The service rows of bench/run.sh alone: configuration-service against a bare HTTP responder
# sending the same bytes and against etcd's HTTP/JSON gateway (Retrieve as a range get, Store as
# a put; both answer a write only once it is on disk), with wrk, medians of REPEATS runs in an
# order that rotates between the servers. Fails on any socket error or non-2xx answer and leaves
# nothing behind (store, etcd data, payloads, processes).
#
# Usage: bench/service_vs_etcd.sh   (environment as for bench/run.sh: BUILD_DIR, DURATION,
#                                    REPEATS, CONNECTIONS, SERVICE_BIN, SKIP_BUILD)
exec "$(dirname "${BASH_SOURCE[0]}")/run.sh" --service-only
