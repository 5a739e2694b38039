#!/usr/bin/env bash
# The main job: builds the shipping DLL and the native library with the
# tools, plays the embedded demo scene against the library, renders what the
# frame editor shows of a new object with its template in view, and says
# where the DLL and the pictures are. Each step says what it does as it
# starts; the builds show their own progress.
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
# Placed 40 pixels in, so that the leftmost label, which reaches past the
# object's rectangle, is in the picture too.
step "rendering the editor's template view into out/editor-preview.png"
build/release/tools/editor_preview/editor_preview --view-template 1 --left 40 out/editor-preview.png
echo "tavrin.dll (for the host):  $(pwd)/build/mingw-i686/tavrin.dll"
echo "its debug information:      $(pwd)/build/mingw-i686/tavrin.dll.debug"
echo "libtavrin.so (native):      $(pwd)/build/release/libtavrin.so"
echo "the demo, played:           $(pwd)/out/demo.gif"
echo "the editor's template view: $(pwd)/out/editor-preview.png"
