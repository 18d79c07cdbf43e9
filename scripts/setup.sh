#!/usr/bin/env bash
# Installs the Debian packages the build, tests and tools need, when missing.
set -euo pipefail
packages=(cmake ninja-build g++ clang libclang-rt-14-dev pkg-config libboost-dev zlib1g-dev
          libgtest-dev libgmock-dev libbenchmark-dev libcli11-dev librsvg2-bin python3
          zip unzip p7zip-full doxygen
          # Debian packages (scripts/package.sh) and their checks: cpack's dpkg-shlibdeps and
          # dpkg-deb, lintian, the manual page's renderer, the exported-symbol check's nm.
          dpkg-dev lintian man-db groff-base file binutils)
missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
if ((${#missing[@]})); then
  echo "Installing: ${missing[*]}"
  sudo_cmd=()
  [[ $(id -u) -ne 0 ]] && sudo_cmd=(sudo)
  "${sudo_cmd[@]}" apt-get update -qq
  DEBIAN_FRONTEND=noninteractive "${sudo_cmd[@]}" apt-get install -y -qq "${missing[@]}" >/dev/null
fi
