#!/usr/bin/env bash
# Opens the bundled demo comp. With no display it runs headless and writes
# screenshots of the inspector and viewer, printing their paths.
set -euo pipefail
build=${1:-build/release}
here=$(cd "$(dirname "$0")/.." && pwd)
comp="$here/examples/demo.lua"
if [ -n "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ]; then
    exec "$build/bin/orbane" "$comp"
fi
out=${ORBANE_SHOTS:-$here/build/screenshots}
mkdir -p "$out"
exec "$build/bin/orbane" --headless --screenshots "$out" "$comp"
