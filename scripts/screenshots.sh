#!/usr/bin/env bash
# Remakes the README's pictures: runs the demo under Xvfb and saves the list page, a report and
# the installation page as PNG files in docs/, in the light appearance and, as *-dark.png, in the
# dark one. Run it again whenever the window changes.
# Usage: scripts/screenshots.sh [BUILD_DIR]
set -euo pipefail
cd "$(dirname "$0")/.."
if [ "${1:-}" != "--under-xvfb" ]; then
  scripts/install-deps.sh --screenshots
  build=${1:-build}
  cmake -S . -B "$build" > /dev/null
  cmake --build "$build" -j"$(nproc)" --target orbelane-verification-storage orbelane-demo-tree \
    orbelane-stand-in-portal
  exec xvfb-run -a -s "-screen 0 1280x900x24" "$0" --under-xvfb "$build"
fi
build=$2
if [ -z "${3:-}" ]; then
  # Each appearance on a session bus of its own, whose stand-in settings portal asks for it: the
  # desktop's own bus, if any, plays no part.
  dbus-run-session -- "$0" --under-xvfb "$build" light
  dbus-run-session -- "$0" --under-xvfb "$build" dark
  exit
fi
scheme=$3
suffix=$([ "$scheme" = dark ] && echo -dark || true)
root=$(mktemp -d -t orbelane-screenshots.XXXXXX)
trap 'kill "${program:-}" "${portal:-}" 2>/dev/null; rm -rf "$root"' EXIT
"$build/orbelane-stand-in-portal" "$scheme" &
portal=$!
for _ in $(seq 50); do
  dbus-send --session --print-reply --dest=org.freedesktop.portal.Desktop \
    /org/freedesktop/portal/desktop org.freedesktop.portal.Settings.Read \
    string:org.freedesktop.appearance string:color-scheme > /dev/null 2>&1 && break
  sleep 0.1
done
"$build/orbelane-demo-tree" "$root"
ORBELANE_ROOT="$root" "$build/orbelane-verification-storage" &
program=$!
window=$(timeout 20 xdotool search --sync --onlyvisible --name "^Orbelane Verification Storage$" |
  head -1)
mkdir -p docs

# Points in the window's own coordinates: a control's place in the control table, moved down by
# the height of the menu bar, which stands in the window above the controls.
menu=19
shot() {
  sleep 1
  xwd -id "$window" -silent | convert xwd:- -define png:exclude-chunk=date,time "docs/$1$suffix.png"
  echo "docs/$1$suffix.png"
}
shot list
xdotool mousemove --window "$window" 300 $((180 + menu)) click --repeat 2 --delay 80 1
shot report
xdotool mousemove --window "$window" 250 $((32 + menu)) click 1
shot installation
