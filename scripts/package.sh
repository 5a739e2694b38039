#!/usr/bin/env bash
# Makes the release package out/tavrin-VERSION.zip (the version is the
# project's, in CMakeLists.txt): the shipping tavrin.dll, the author's guide
# as HTML with its pictures, the example scenes, LICENSE and SHA256SUMS.
# The build of the shipping DLL makes the package beside it
# (cmake/release_package.cmake); this copies it out.
set -euo pipefail
cd "$(dirname "$0")/.."
echo "== checking the packages the build needs" >&2
scripts/install-deps.sh
echo "== building the shipping DLL and its package" >&2
cmake --preset mingw-i686 >/dev/null
cmake --build --preset mingw-i686 -j "$(nproc)"
version=$(sed -n 's/^CMAKE_PROJECT_VERSION:STATIC=//p' build/mingw-i686/CMakeCache.txt)
mkdir -p out
cp "build/mingw-i686/tavrin-$version.zip" out/
echo "the release package: $(pwd)/out/tavrin-$version.zip"
