#!/usr/bin/env bash
# Checks the Debian package the way a user meets it: a fresh minimal Debian 12 made with
# debootstrap, `apt-get install ./package.deb` there, then the installed program run under Xvfb
# against a demo tree, with "Illustrator CC" chosen and "Install Now" pressed. Needs root and
# Debian's mirror; takes a few minutes. Nothing is installed on this machine but debootstrap.
# Usage: scripts/check-deb.sh PACKAGE.deb BUILD_DIR
set -euo pipefail
deb=$(realpath "$1")
demo=$(realpath "$2")/orbelane-demo-tree
command -v debootstrap > /dev/null || apt-get install -y debootstrap
work=$(mktemp -d -t orbelane-chroot.XXXXXX)
root=$work/root
cleanup() {
  umount -R "$root/proc" "$root/sys" "$root/dev" 2> /dev/null || true
  # Never remove a tree that still has the machine's /dev bound into it.
  if ! grep -q " $root/" /proc/mounts; then
    rm -rf --one-file-system "$work"
  else
    echo "left $work: still mounted" >&2
  fi
}
trap cleanup EXIT

echo "== debootstrap bookworm (minbase)"
debootstrap --variant=minbase bookworm "$root" http://deb.debian.org/debian > "$work/debootstrap.log"
mount -t proc proc "$root/proc"
mount -t sysfs sys "$root/sys"
mount --rbind /dev "$root/dev"
cp /etc/resolv.conf "$root/etc/resolv.conf"
cp "$deb" "$root/root/"
in_root() { chroot "$root" env -i PATH=/usr/local/bin:/usr/sbin:/usr/bin:/sbin:/bin HOME=/root "$@"; }

echo "== apt-get install ./$(basename "$deb")"
in_root apt-get update -qq
in_root env DEBIAN_FRONTEND=noninteractive apt-get install -y "./root/$(basename "$deb")" \
  > "$work/apt.log"
grep -E "newly installed|^Setting up $(dpkg-deb -f "$deb" Package) " "$work/apt.log"

echo "== tools to drive it: xvfb xdotool x11-apps, and the demo tree maker"
in_root env DEBIAN_FRONTEND=noninteractive apt-get install -y --no-install-recommends \
  xvfb xauth xdotool x11-apps > /dev/null
cp "$demo" "$root/usr/local/bin/"

cat > "$root/root/press.sh" << 'SCRIPT'
set -u
orbelane-demo-tree /root/demo
plugins="/root/demo/Users/user/Library/Application Support/Adobe/Adobe Illustrator 23/en_US/Plug-ins"
Xvfb :7 -screen 0 1280x900x24 -nolisten tcp 2> /dev/null &
xvfb=$!
sleep 1
export DISPLAY=:7
cd /var/tmp
echo "program: $(command -v orbelane-verification-storage), working directory $(pwd)"
ORBELANE_ROOT=/root/demo orbelane-verification-storage 2> /dev/null &
program=$!
w=$(timeout 20 xdotool search --sync --onlyvisible --name "^Orbelane Verification Storage$" | head -1)
sleep 1
# Control-table places, moved down by the menu bar's 19 pixels.
xdotool mousemove --window "$w" 250 51 click 1; sleep 0.7          # "Installation"
xdotool mousemove --window "$w" 483 427 click 1; sleep 0.7         # the product popup
xdotool key End; sleep 0.3; xdotool key Return; sleep 0.7          # "Illustrator CC"
xdotool mousemove --window "$w" 483 500 click 1; sleep 2           # "Install Now"
for id in $(xdotool search --onlyvisible --name "^Orbelane Verification Storage$"); do
  [ "$id" = "$w" ] || xwd -id "$id" -silent > /root/message.xwd
done
kill "$program" "$xvfb"
wait
echo "plug-ins folder after the press:"
find "$plugins" | sed "s|^$plugins|  Plug-ins|"
test -f "$plugins/Quilbrant.aip/Contents/Info.plist"
SCRIPT
echo "== run and press Install Now for Illustrator CC"
in_root bash /root/press.sh
if [ -f "$root/root/message.xwd" ] && command -v convert > /dev/null; then
  convert xwd:"$root/root/message.xwd" "$(dirname "$deb")/install-message.png"
  echo "the message box: $(dirname "$deb")/install-message.png"
fi
echo "== passed"
