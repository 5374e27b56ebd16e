#!/usr/bin/env bash
# Installs the Debian packages the build needs, when they are missing.
# Idempotent: a machine that has everything is left alone.
set -euo pipefail

packages=(
    build-essential cmake pkg-config git
    qtbase5-dev libqt5svg5-dev
    libluajit-5.1-dev luajit libmuparser-dev libpolyclipping-dev libpugixml-dev
    libopenimageio-dev
    libopencolorio-dev
    libopencv-imgproc-dev
    googletest libgtest-dev libbenchmark-dev
    fonts-dejavu-core
    clang libclang-rt-14-dev
)

missing=()
for p in "${packages[@]}"; do
    dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q 'install ok installed' || missing+=("$p")
done
[ ${#missing[@]} -eq 0 ] && exit 0

echo "setup: installing ${missing[*]}"
sudo_cmd=()
[ "$(id -u)" -eq 0 ] || sudo_cmd=(sudo)
export DEBIAN_FRONTEND=noninteractive
"${sudo_cmd[@]}" apt-get update -qq
"${sudo_cmd[@]}" apt-get install -y -qq --no-install-recommends "${missing[@]}"
