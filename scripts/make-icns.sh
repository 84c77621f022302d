#!/usr/bin/env bash
# Makes packaging/orbelane-verification-storage.icns, the macOS bundle's icon, from the SVG of the
# desktop entry. rsvg-convert (librsvg: `brew install librsvg` on a Mac, librsvg2-bin on Debian)
# draws the ten PNG images of an iconset, 16 to 1024 pixels. On a Mac, Apple's iconutil packs
# them. Elsewhere a few lines of Python pack the same PNG images into the container that iconutil
# writes: "icns" and the file's length, a table of contents, then each image as its type, its
# length and its PNG bytes, all lengths in 4 bytes, big-endian. The checked-in file was made the
# second way, on Debian 12; run this again whenever the SVG changes.
# Usage: scripts/make-icns.sh [OUTPUT.icns]
set -euo pipefail
cd "$(dirname "$0")/.."
svg=packaging/orbelane-verification-storage.svg
out=${1:-packaging/orbelane-verification-storage.icns}
command -v rsvg-convert > /dev/null || { echo "make-icns.sh needs rsvg-convert (librsvg)" >&2; exit 1; }
work=$(mktemp -d -t orbelane-icns.XXXXXX)
trap 'rm -rf "$work"' EXIT
iconset=$work/icon.iconset
mkdir "$iconset"
for size in 16 32 128 256 512; do
  rsvg-convert -w "$size" -h "$size" "$svg" -o "$iconset/icon_${size}x${size}.png"
  rsvg-convert -w $((size * 2)) -h $((size * 2)) "$svg" -o "$iconset/icon_${size}x${size}@2x.png"
done

if command -v iconutil > /dev/null; then
  iconutil -c icns "$iconset" -o "$out"
else
  python3 - "$iconset" "$out" << 'PYTHON'
import struct
import sys

iconset, out = sys.argv[1], sys.argv[2]
# The type under which macOS looks for each image of the iconset, every one held as PNG.
types = [("icp4", "16x16"), ("ic11", "16x16@2x"), ("icp5", "32x32"), ("ic12", "32x32@2x"),
         ("ic07", "128x128"), ("ic13", "128x128@2x"), ("ic08", "256x256"),
         ("ic14", "256x256@2x"), ("ic09", "512x512"), ("ic10", "512x512@2x")]
entries = []
for kind, name in types:
    with open(f"{iconset}/icon_{name}.png", "rb") as png:
        entries.append((kind.encode(), png.read()))
toc = b"".join(kind + struct.pack(">I", 8 + len(data)) for kind, data in entries)
body = b"TOC " + struct.pack(">I", 8 + len(toc)) + toc
body += b"".join(kind + struct.pack(">I", 8 + len(data)) + data for kind, data in entries)
with open(out, "wb") as icns:
    icns.write(b"icns" + struct.pack(">I", 8 + len(body)) + body)
PYTHON
fi
echo "$out"
