#!/usr/bin/env bash
# Installs every Debian package the build, tests, benchmarks and fuzzers use. Idempotent: it asks
# apt only for what is missing, and refreshes the package lists only when something is.
set -euo pipefail

PACKAGES=(
  build-essential cmake pkg-config git
  libace-dev zlib1g-dev libpugixml-dev libcurl4-openssl-dev libssl-dev openssl
  libcpp-httplib-dev libhowardhinnant-date-dev libboost-dev
  libgtest-dev libgmock-dev libbenchmark-dev
  clang libclang-rt-14-dev clang-format
  libdcmtk-dev libsqlite3-dev
  curl wrk etcd-server python3
  graphviz
  help2man lintian
)

missing=()
for p in "${PACKAGES[@]}"; do
  if ! dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed"; then
    missing+=("$p")
  fi
done

if [ ${#missing[@]} -eq 0 ]; then
  echo "install-deps: all packages present"
  exit 0
fi

SUDO=""
if [ "$(id -u)" -ne 0 ]; then SUDO="sudo"; fi
echo "install-deps: installing ${missing[*]}"
$SUDO apt-get update -qq
DEBIAN_FRONTEND=noninteractive $SUDO apt-get install -y -qq --no-install-recommends "${missing[@]}"
