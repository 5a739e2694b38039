#!/usr/bin/env bash
# Builds the shipping DLL and the native library and says where they are.
set -euo pipefail
cd "$(dirname "$0")/.."
scripts/install-deps.sh
jobs=$(nproc)
for preset in release mingw-i686; do
  cmake --preset "$preset" >/dev/null
  cmake --build --preset "$preset" -j "$jobs" >/dev/null
done
echo "tavrin.dll (for the host):  $(pwd)/build/mingw-i686/tavrin.dll"
echo "libtavrin.so (native):      $(pwd)/build/release/libtavrin.so"
