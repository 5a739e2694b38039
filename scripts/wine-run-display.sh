#!/usr/bin/env bash
# Runs a 64-bit Windows program that shows windows (the setup dialog tests)
# under Wine on a virtual X display of its own, in a Wine prefix of its own
# so that no Wine process of a display-less run serves it.
set -euo pipefail
export TAVRIN_WINEPREFIX=${TAVRIN_WINEPREFIX_DISPLAY:-${TMPDIR:-/tmp}/tavrin-wine-display-$(id -u)}
exec xvfb-run -a "$(dirname "$0")/wine-run.sh" "$@"
