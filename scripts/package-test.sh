#!/usr/bin/env bash
# Builds the Debian packages from a build tree, checks them with lintian, installs them with
# dpkg -i, checks the systemd unit (systemd-analyze verify and security), starts the installed
# service the way its unit does (as its user, with the unit's environment and command line; CI
# machines do not run systemd as init), asks it with configctl, and purges the packages.
#   scripts/package-test.sh [BUILD_DIR]   (default: build). Needs root. The tree is configured
#   with -DCMAKE_INSTALL_PREFIX=/usr for the packages and given back its prefix afterwards.
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
build=$(cd "${1:-$root/build}" && pwd)
work=$(mktemp -d /tmp/configuration-package.XXXXXX)
unit=/lib/systemd/system/configuration-service.service
service=""
installed=""
prefix=$(sed -n 's/^CMAKE_INSTALL_PREFIX:PATH=//p' "$build/CMakeCache.txt")
cleanup() {
  if [ -n "$service" ]; then kill -TERM "$service" 2>/dev/null || true; wait "$service" 2>/dev/null || true; fi
  cmake -DCMAKE_INSTALL_PREFIX="${prefix:-/usr/local}" "$build" >/dev/null || true
  if [ -n "$installed" ]; then dpkg --purge $packages >/dev/null || true; fi
  rm -rf "$work"
}
trap cleanup EXIT
fail() { echo "package-test: $*" >&2; exit 1; }
packages="configuration-service libconfiguration-dev libconfiguration0"

echo "=== build the packages"
cmake -DCMAKE_INSTALL_PREFIX=/usr "$build" >/dev/null
cmake --build "$build" -j"$(nproc)" --target Configuration ServerInterop configctl configuration-service man-pages
(cd "$work" && cpack --config "$build/CPackConfig.cmake" -B "$work" >cpack.log) ||
  { cat "$work/cpack.log"; fail "cpack failed"; }
debs=$(ls "$work"/*.deb)
for d in $debs; do dpkg-deb -I "$d" | sed -n 's/^ \(Package\|Depends\): /  /p'; done

echo "=== lintian"
lintian --tag-display-limit 0 $debs | tee "$work/lintian.txt" || true
echo "lintian: $(grep -c '^E:' "$work/lintian.txt" || true) errors, $(grep -c '^W:' "$work/lintian.txt" || true) warnings"

echo "=== dpkg -i"
installed=yes
dpkg -i $debs >/dev/null
getent passwd quorvex-config >/dev/null || fail "no service user"
[ "$(stat -c '%a %U' /etc/quorvex/service-ticket)" = "600 quorvex-config" ] || fail "ticket mode/owner"
[ -f /usr/share/man/man1/configctl.1.gz ] && [ -f /usr/share/man/man8/configuration-service.8.gz ] ||
  fail "man pages missing"
configctl --help >/dev/null || fail "configctl does not run"

echo "=== the unit"
systemd-analyze verify "$unit"
systemd-analyze security --offline=true "$unit" | tail -n 1

echo "=== start the service the way the unit does"
printf 'PORT=0\n' >/etc/default/configuration-service
install -d -m 0755 -o quorvex-config -g quorvex-config /run/quorvex-configuration /run/quorvex-events
rm -f /run/quorvex-configuration/port
env_args=()
while read -r line; do
  for kv in $line; do env_args+=("$kv"); done
done < <(sed -n 's/^Environment=//p' "$unit"; grep -v '^#' /etc/default/configuration-service)
exec_start=$(sed -n 's/^ExecStart=//p' "$unit")
command=$(env -i "${env_args[@]}" bash -c 'eval "echo $1"' _ "$exec_start")
# shellcheck disable=SC2086
setpriv --reuid=quorvex-config --regid=quorvex-config --init-groups --no-new-privs \
  env -i "${env_args[@]}" $command &
service=$!
for _ in $(seq 1 100); do [ -s /run/quorvex-configuration/port ] && break; sleep 0.1; done
[ -s /run/quorvex-configuration/port ] || fail "the installed service did not start"
server="127.0.0.1:$(cat /run/quorvex-configuration/port)"
# The ticket belongs to the service's user: administrators run configctl as that user.
as_service() { setpriv --reuid=quorvex-config --regid=quorvex-config --init-groups "$@"; }
as_service configctl --server "$server" whoami
cp "$root/examples/site/OrvelSystemCommon.xml" "$work/document.xml"
chmod 755 "$work" && chmod 644 "$work/document.xml"
as_service configctl --server "$server" put 'BrimmetServer\OrvelSystemCommon' "$work/document.xml"
[ "$(as_service configctl --server "$server" exists 'BrimmetServer\OrvelSystemCommon')" = yes ] ||
  fail "the installed service did not give the document back"
kill -TERM "$service"; wait "$service" || true; service=""
rm -rf /run/quorvex-configuration /run/quorvex-events

echo "=== dpkg --purge"
dpkg --purge $packages >/dev/null
installed=""
for p in $packages; do
  ! dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q installed || fail "$p still installed"
done
[ ! -e /var/lib/quorvex-configuration ] && [ ! -e /etc/quorvex ] || fail "files left after purge"
! getent passwd quorvex-config >/dev/null || fail "the service user is left"
! ls /usr/lib/libConfiguration* /usr/lib/*/libConfiguration* 2>/dev/null | grep -q . || fail "libraries left"
echo "=== package test passed"
