#!/usr/bin/env bash
# Makes the Debian package of a built tree, unpacks it into a temporary folder and checks what
# stands there: the program, both plug-in items where the program looks for them, the desktop
# entry and the icon, nothing else, and the libraries that the package depends on.
# Usage: scripts/check-install.sh [BUILD_DIR]
set -euo pipefail
cd "$(dirname "$0")/.."
build=$(cd "${1:-build}" && pwd)
work=$(mktemp -d -t orbelane-install.XXXXXX)
trap 'rm -rf "$work"' EXIT
(cd "$work" && cpack -G DEB -B "$work/package" --config "$build/CPackConfig.cmake" > cpack.log 2>&1) ||
  { cat "$work/cpack.log"; exit 1; }
deb=$(ls "$work"/package/*.deb)
dpkg-deb -x "$deb" "$work/root"
prefix=$work/root/usr

name=orbelane-verification-storage
failed=0
expect() {
  if [ "$1" "$prefix/$2" ]; then
    echo "ok      $2"
  else
    echo "MISSING $2"
    failed=1
  fi
}
expect -x "bin/$name"
expect -f "share/$name/Quilbrant.aip/Contents/Info.plist"
expect -f "share/$name/Ostrelin.acroplugin/Contents/Info.plist"
expect -f "share/applications/$name.desktop"
expect -f "share/icons/hicolor/scalable/apps/$name.svg"
expect -f "share/icons/hicolor/128x128/apps/$name.png"
if [ -f "$prefix/share/applications/$name.desktop" ]; then
  desktop-file-validate "$prefix/share/applications/$name.desktop" || failed=1
fi
# Nothing else is in the package: no test, benchmark or demo program, no static library.
unexpected=$(cd "$prefix" && find . -type f | grep -v -e "^./bin/$name\$" -e "^./share/$name/" \
  -e "^./share/applications/$name.desktop\$" -e "^./share/icons/hicolor/scalable/apps/$name.svg\$" \
  -e "^./share/icons/hicolor/128x128/apps/$name.png\$" \
  || true)
[ "$(ls -A "$work/root")" = usr ] || unexpected="$unexpected $(ls -A "$work/root")"
if [ -n "$unexpected" ]; then
  echo "Unexpected files installed:"
  echo "$unexpected"
  failed=1
fi

depends=$(dpkg-deb -f "$deb" Depends)
echo "package $(basename "$deb"): Depends: $depends"
for library in libqt6widgets6 libsqlite3-0; do
  [[ $depends == *"$library "* ]] || { echo "MISSING dependency $library"; failed=1; }
done
exit $failed
