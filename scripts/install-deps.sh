#!/usr/bin/env bash
# Installs what the project builds and tests with, on Debian, as root. Quiet
# and quick when everything is already there.
set -euo pipefail
packages=(
  cmake g++ make git
  googletest libgtest-dev libgmock-dev libbenchmark-dev
  clang libclang-rt-14-dev
  gcc-multilib g++-multilib qemu-user-static
  g++-mingw-w64-i686 g++-mingw-w64-x86-64 binutils-mingw-w64-i686 binutils-mingw-w64-x86-64
  wine wine64 fonts-wine xvfb xauth
  libgif-dev libpng-dev nlohmann-json3-dev libcairo2-dev fonts-dejavu-core
  python3 python3-markdown
  libbox2d-dev
)
missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
if [ ${#missing[@]} -gt 0 ]; then
  echo "installing: ${missing[*]}" >&2
  export DEBIAN_FRONTEND=noninteractive
  apt-get update -qq
  apt-get install -y -qq --no-install-recommends "${missing[@]}" >/dev/null
fi
