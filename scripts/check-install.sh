#!/usr/bin/env bash
# Makes the Debian package of a built tree, unpacks it into a temporary folder and checks what
# stands there: the program, both plug-in items where the program looks for them, the desktop
# entry, the icon, the AppStream entry, the copyright file and the history, nothing else, and
# the libraries that the package depends on. lintian checks the package as Debian's archive
# would, and appstreamcli the AppStream entry.
# Usage: scripts/check-install.sh [BUILD_DIR]
set -euo pipefail
cd "$(dirname "$0")/.."
scripts/install-deps.sh --release
build=$(cd "${1:-build}" && pwd)
work=$(mktemp -d -t orbelane-install.XXXXXX)
trap 'rm -rf "$work"' EXIT
(cd "$work" && cpack -G DEB -B "$work/package" --config "$build/CPackConfig.cmake" > cpack.log 2>&1) ||
  { cat "$work/cpack.log"; exit 1; }
deb=$(ls "$work"/package/*.deb)
dpkg-deb -x "$deb" "$work/root"
prefix=$work/root/usr

name=orbelane-verification-storage
id=com.orbelane.verification-storage
failed=0
expect() {
  if test "$1" "$prefix/$2"; then
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
expect -f "share/metainfo/$id.metainfo.xml"
expect -f "share/doc/$name/copyright"
expect -f "share/doc/$name/changelog.gz"
if [ -f "$prefix/share/applications/$name.desktop" ]; then
  desktop-file-validate "$prefix/share/applications/$name.desktop" || failed=1
fi
if [ -f "$prefix/share/metainfo/$id.metainfo.xml" ]; then
  appstreamcli validate --no-net "$prefix/share/metainfo/$id.metainfo.xml" || failed=1
fi
# Nothing else is in the package: no test, benchmark or demo program, no static library.
unexpected=$(cd "$prefix" && find . -type f | grep -v -e "^./bin/$name\$" -e "^./share/$name/" \
  -e "^./share/applications/$name.desktop\$" -e "^./share/icons/hicolor/scalable/apps/$name.svg\$" \
  -e "^./share/metainfo/$id.metainfo.xml\$" -e "^./share/doc/$name/copyright\$" \
  -e "^./share/doc/$name/changelog.gz\$" || true)
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
# No error and no warning, but for the manual page: the program has no command line to describe.
lintian --display-info --fail-on none "$deb" 2>&1 | grep -v "running with root privileges" |
  tee "$work/lintian.log"
if grep -E '^[EW]: ' "$work/lintian.log" | grep -qv ' no-manual-page '; then
  echo "lintian: an error or a warning above"
  failed=1
fi

version=$(dpkg-deb -f "$deb" Version)
newest=$(zcat "$prefix/share/doc/$name/changelog.gz" | sed -n '1s/^[^ ]* (\([^)]*\)).*/\1/p')
[ "$newest" = "$version" ] || { echo "changelog's newest entry is $newest, not $version"; failed=1; }
release=$(grep -o -m1 '<release version="[^"]*"' "$prefix/share/metainfo/$id.metainfo.xml" | cut -d'"' -f2)
[ "$release" = "$version" ] || { echo "metainfo's newest release is $release, not $version"; failed=1; }
exit $failed
