#!/usr/bin/env bash
# Runs a 64-bit Windows program under Wine, in a prefix of its own beside the
# build (made once, under a lock, so parallel tests do not race to make it).
set -euo pipefail
prefix=${TAVRIN_WINEPREFIX:-${TMPDIR:-/tmp}/tavrin-wine-$(id -u)}
export WINEPREFIX=$prefix WINEDEBUG=-all WINEDLLOVERRIDES="mscoree,mshtml="
wine=/usr/lib/wine/wine64
[ -x "$wine" ] || wine=$(command -v wine64 || command -v wine)
mkdir -p "$(dirname "$prefix")"
(
  flock 9
  if [ ! -f "$prefix/.tavrin-ready" ]; then
    "$wine" wineboot --init >/dev/null 2>&1 || true
    # No window manager runs on the test display: windows left to one make
    # Wine wait for it at every show and hide.
    "$wine" reg add 'HKCU\Software\Wine\X11 Driver' /v Managed /d N /f >/dev/null 2>&1 || true
    touch "$prefix/.tavrin-ready"
  fi
) 9>"$prefix.lock"
# One server kept alive across the many short runs of a test session: a new
# client that meets a server just shutting down fails to connect.
server=$(dirname "$wine")/wineserver64
[ -x "$server" ] || server=$(command -v wineserver)
"$server" -p30 </dev/null >/dev/null 2>&1 || true
exec "$wine" "$@"
