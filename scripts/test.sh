#!/usr/bin/env bash
# Builds every target and runs every test: the native test build (sanitized),
# the fuzzers for a bounded time over their seed corpora, the checks of the
# Windows images, the tests under Wine, the 32-bit x86 test build under
# emulation, and there the tests through the entry points against the
# shipping tavrin.dll itself. The release build (tools and benchmarks) is
# compiled so that it cannot rot, but the benchmarks are not run here.
set -euo pipefail
cd "$(dirname "$0")/.."
scripts/install-deps.sh
jobs=$(nproc)
for preset in debug release fuzz mingw-i686 mingw-x64 i386; do
  cmake --preset "$preset" >/dev/null
  cmake --build --preset "$preset" -j "$jobs"
done
for preset in debug fuzz mingw-i686 mingw-x64 i386 shipping; do
  ctest --preset "$preset" -j "$jobs"
done
