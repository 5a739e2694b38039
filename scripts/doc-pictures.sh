#!/usr/bin/env bash
# Makes the pictures of docs/ again: the recipes' animations, played from
# their scenes by the scene player; the frame editor's template view; and the
# setup dialog and its help, shown by the Windows test build's DLL under Wine
# on a virtual display. The dialog asks for the font "Helv", which Windows
# gives as MS Sans Serif: the pictures are taken in a Wine prefix of their own
# that holds the faces Wine ships, MS Sans Serif among them, so that the
# labels are laid out as authors see them.
set -euo pipefail
cd "$(dirname "$0")/.."
repo=$(pwd)
step() { echo "== $*" >&2; }
step "checking the packages the build needs"
scripts/install-deps.sh
step "building the tools and the Windows test build"
cmake --preset release >/dev/null
cmake --build --preset release -j "$(nproc)" --target scene_player editor_preview
cmake --preset mingw-x64 >/dev/null
cmake --build --preset mingw-x64 -j "$(nproc)" --target tavrin dravo2 dialog_screenshot

for scene in docs/recipes/*.json; do
  step "playing $scene"
  build/release/tools/scene_player/scene_player "$scene" --gif "${scene%.json}.gif"
done
step "rendering the editor's template view"
build/release/tools/editor_preview/editor_preview --view-template 1 --starting-angle 45 docs/editor-preview.png

step "taking the pictures of the setup dialog under Wine"
work=$(mktemp -d)
export TAVRIN_WINEPREFIX=$work/prefix TAVRIN_WINEPREFIX_DISPLAY=$work/prefix
# Wine's server for this prefix is ended before its folder goes.
trap 'WINEPREFIX=$work/prefix wineserver -k 2>/dev/null || true; rm -rf "$work"' EXIT
x64=build/mingw-x64
cp "$x64/tavrin.dll" "$x64/standin/dravo2/DRAVO2.dll" "$x64/tools/dialog_screenshot/dialog_screenshot.exe" "$work/"
scripts/wine-run.sh reg add 'HKLM\Software\Microsoft\Windows NT\CurrentVersion\FontSubstitutes' \
  /v Helv /d 'MS Sans Serif' /f >/dev/null
cp /usr/share/wine/fonts/* "$work/prefix/drive_c/windows/Fonts/"
(cd "$work" && "$repo/scripts/wine-run-display.sh" dialog_screenshot.exe tavrin.dll dialog.bmp help.bmp)
python3 - "$work/dialog.bmp" docs/setup-dialog.png "$work/help.bmp" docs/setup-help.png <<'EOF'
# 24-bit BMP files (bottom-up rows of blue, green, red) to PNG files.
import struct, sys, zlib
for source, target in zip(sys.argv[1::2], sys.argv[2::2]):
    data = open(source, "rb").read()
    offset, = struct.unpack_from("<I", data, 10)
    width, height = struct.unpack_from("<ii", data, 18)
    stride = (width * 3 + 3) & ~3
    rows = [data[offset + y * stride:offset + y * stride + width * 3] for y in reversed(range(height))]
    raw = b"".join(b"\0" + bytes(row[i + j] for i in range(0, len(row), 3) for j in (2, 1, 0)) for row in rows)
    chunk = lambda kind, body: struct.pack(">I", len(body)) + kind + body + struct.pack(">I", zlib.crc32(kind + body))
    png = b"\x89PNG\r\n\x1a\n" + chunk(b"IHDR", struct.pack(">IIBBBBB", width, height, 8, 2, 0, 0, 0))
    open(target, "wb").write(png + chunk(b"IDAT", zlib.compress(raw, 9)) + chunk(b"IEND", b""))
    print(f"{target}: {width} x {height}")
EOF
