#!/usr/bin/env bash
# Installs a built tree into a temporary prefix and checks what stands there: the program, both
# plug-in items where the program looks for them, the desktop entry and the icon. Then makes the
# Debian package and checks that it holds the program and depends on the libraries it links.
# Usage: scripts/check-install.sh [BUILD_DIR]
set -euo pipefail
cd "$(dirname "$0")/.."
build=${1:-build}
prefix=$(mktemp -d -t orbelane-install.XXXXXX)
trap 'rm -rf "$prefix"' EXIT
cmake --install "$build" --prefix "$prefix" > /dev/null

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
if [ -f "$prefix/share/applications/$name.desktop" ]; then
  desktop-file-validate "$prefix/share/applications/$name.desktop" || failed=1
fi
# Nothing else is installed: no test, benchmark or demo program, no static library.
unexpected=$(cd "$prefix" && find . -type f | grep -v -e "^./bin/$name\$" -e "^./share/$name/" \
  -e "^./share/applications/$name.desktop\$" -e "^./share/icons/hicolor/scalable/apps/$name.svg\$" \
  || true)
if [ -n "$unexpected" ]; then
  echo "Unexpected files installed:"
  echo "$unexpected"
  failed=1
fi

build=$(cd "$build" && pwd)
(cd "$prefix" && cpack -G DEB -B "$prefix/package" --config "$build/CPackConfig.cmake" > cpack.log 2>&1) ||
  { cat "$prefix/cpack.log"; exit 1; }
deb=$(ls "$prefix"/package/*.deb)
depends=$(dpkg-deb -f "$deb" Depends)
echo "package $(basename "$deb"): Depends: $depends"
dpkg-deb -c "$deb" > "$prefix/contents"
grep -q " ./usr/bin/$name\$" "$prefix/contents" || { echo "MISSING usr/bin/$name in the package"; failed=1; }
for library in libqt6widgets6 libsqlite3-0; do
  [[ $depends == *"$library "* ]] || { echo "MISSING dependency $library"; failed=1; }
done
exit $failed
