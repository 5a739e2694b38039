#!/usr/bin/env bash
# The main job: builds the shipping DLL and the native library with the
# tools, plays the embedded demo scene against the library, renders what the
# frame editor shows of a new object with its template in view, and says
# where the DLL and the pictures are.
set -euo pipefail
cd "$(dirname "$0")/.."
scripts/install-deps.sh
jobs=$(nproc)
for preset in release mingw-i686; do
  cmake --preset "$preset" >/dev/null
  cmake --build --preset "$preset" -j "$jobs" >/dev/null
done
mkdir -p out
build/release/tools/scene_player/scene_player --gif out/demo.gif >/dev/null
build/release/tools/editor_preview/editor_preview --view-template 1 out/editor-preview.png
echo "tavrin.dll (for the host):  $(pwd)/build/mingw-i686/tavrin.dll"
echo "libtavrin.so (native):      $(pwd)/build/release/libtavrin.so"
echo "the demo, played:           $(pwd)/out/demo.gif"
echo "the editor's template view: $(pwd)/out/editor-preview.png"
