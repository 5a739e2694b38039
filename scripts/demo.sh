#!/usr/bin/env bash
# The main job: builds the shipping DLL and the native library with the
# tools, plays the embedded demo scene against the library, and says where
# the DLL and the animated GIF are. Each step says what it does as it starts;
# the builds show their own progress.
set -euo pipefail
cd "$(dirname "$0")/.."
step() { echo "== $*" >&2; }
step "checking the packages the build needs"
scripts/install-deps.sh
jobs=$(nproc)
for preset in release mingw-i686; do
  step "configuring and building preset $preset"
  cmake --preset "$preset" >/dev/null
  cmake --build --preset "$preset" -j "$jobs"
done
step "playing the demo scene into out/demo.gif"
mkdir -p out
build/release/tools/scene_player/scene_player --gif out/demo.gif
echo "tavrin.dll (for the host):  $(pwd)/build/mingw-i686/tavrin.dll"
echo "libtavrin.so (native):      $(pwd)/build/release/libtavrin.so"
echo "the demo, played:           $(pwd)/out/demo.gif"
