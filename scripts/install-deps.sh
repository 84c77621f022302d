#!/usr/bin/env bash
# Installs every build and test dependency from Debian packages; skips what is present.
set -euo pipefail
packages=(cmake make g++ qt6-base-dev libqt6svg6 libsqlite3-dev libgtest-dev sqlite3
  fonts-liberation desktop-file-utils dpkg-dev dbus)
if [ "${1:-}" = "--demo" ]; then
  packages+=(xvfb)
elif [ "${1:-}" = "--screenshots" ]; then
  packages+=(xvfb xdotool x11-apps imagemagick)
elif [ "${1:-}" = "--release" ]; then
  packages+=(lintian appstream yamllint)
fi
missing=()
for p in "${packages[@]}"; do
  dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing+=("$p")
done
if [ ${#missing[@]} -gt 0 ]; then
  sudo_cmd=""
  [ "$(id -u)" -ne 0 ] && sudo_cmd="sudo"
  $sudo_cmd apt-get update
  DEBIAN_FRONTEND=noninteractive $sudo_cmd apt-get install -y "${missing[@]}"
fi
