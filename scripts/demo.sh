#!/usr/bin/env bash
# Installs the dependencies, builds, makes a demo tree in a temporary folder and runs the
# program on it. Without a display it runs under Xvfb.
set -euo pipefail
cd "$(dirname "$0")/.."
scripts/install-deps.sh --demo
cmake -S . -B build -DCMAKE_BUILD_TYPE=RelWithDebInfo
cmake --build build -j"$(nproc)" --target orbelane-verification-storage orbelane-demo-tree
root=$(mktemp -d -t orbelane-demo.XXXXXX)
build/orbelane-demo-tree "$root"
echo "Demo tree: $root"
if [ -n "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ]; then
  ORBELANE_ROOT="$root" build/orbelane-verification-storage
else
  echo "No display here: the program runs under Xvfb, unseen. Stop it with Ctrl+C."
  ORBELANE_ROOT="$root" xvfb-run -a build/orbelane-verification-storage
fi
