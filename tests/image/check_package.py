#!/usr/bin/env python3
"""Checks the release package: one folder named for the version, holding the
DLL as built, the guide as HTML with every file it links to, the scenes, the
licence, and checksums that cover every other file.

usage: check_package.py PACKAGE.zip LIBRARY.dll VERSION
"""
import hashlib
import re
import sys
import zipfile


def main(path, dll, version):
    root = f"tavrin-{version}/"
    with zipfile.ZipFile(path) as package:
        files = {info.filename[len(root):]: package.read(info) for info in package.infolist()
                 if not info.is_dir() and info.filename.startswith(root)}
        strays = [name for name in package.namelist() if not name.startswith(root)]
    failures = [f"outside {root}: {name}" for name in strays]
    with open(dll, "rb") as f:
        if files.get("tavrin.dll") != f.read():
            failures.append("tavrin.dll is not the DLL that was built")
    for name in ("guide.html", "LICENSE", "demo-scene.json", "SHA256SUMS"):
        if name not in files:
            failures.append(f"no {name}")
    if b"MIT License" not in files.get("LICENSE", b""):
        failures.append("LICENSE is not the MIT licence")
    links = re.findall(r'(?:src|href)="([^"#:]+)"', files.get("guide.html", b"").decode())
    failures += [f"guide.html links to {link}, which is not in the package" for link in links if link not in files]
    if not any(link.startswith("recipes/") and link.endswith(".gif") for link in links):
        failures.append("guide.html shows no recipe")
    sums = {}
    for line in files.get("SHA256SUMS", b"").decode().splitlines():
        digest, name = line.split("  ", 1)
        sums[name] = digest
    expected = {name: hashlib.sha256(data).hexdigest() for name, data in files.items() if name != "SHA256SUMS"}
    if sums != expected:
        failures.append(f"SHA256SUMS does not list exactly the other files with their checksums:\n  {sums}")
    if failures:
        sys.exit(f"{path}:\n" + "\n".join(failures))
    print(f"{path}: {len(files)} files, {len(links)} links from the guide, checksums right")


if __name__ == "__main__":
    main(*sys.argv[1:])
