#!/usr/bin/env bash
# Makes the disk image of a release on a Mac, from a clean checkout, in build-macos-release/:
#   1. builds the application bundle for arm64 and x86_64 (Release, no tests, no benchmarks) and
#      checks that its executable holds both;
#   2. runs macdeployqt, without -dmg, which copies Qt's frameworks and plug-ins into the bundle;
#   3. signs from the inside out: Qt's plug-ins and frameworks, then each plug-in item in
#      Contents/Resources (bundles that `codesign --deep` does not reach), then the application
#      with the hardened runtime and a secure timestamp, and verifies the whole;
#   4. makes the disk image with hdiutil: the application and a link to /Applications;
#   5. signs the disk image;
#   6. sends it to Apple's notary service and waits for the verdict, then staples the ticket to
#      it, so that Gatekeeper accepts it without asking Apple.
# The application needs no entitlements file: it loads no code but its own and Qt's, signed by
# the same identity, and it neither compiles code at run time nor is debugged.
#
# Environment:
#   QT_PREFIX          Qt 6 for macOS, the folder holding bin/macdeployqt; universal, as Qt's own
#                      installer gives it (Homebrew's is built for one architecture). Required.
#   CODESIGN_IDENTITY  the "Developer ID Application: ..." identity in the keychain.
#   NOTARY_PROFILE     the keychain profile saved by `xcrun notarytool store-credentials`.
# Without CODESIGN_IDENTITY the code is signed ad hoc, the image is not signed and nothing is
# notarised: the image, named "-unsigned", is for testing, and Gatekeeper turns it away on any
# other Mac. With an identity and no NOTARY_PROFILE, everything is signed and nothing notarised.
# Usage: QT_PREFIX=~/Qt/6.8.3/macos scripts/macos-release.sh
set -euo pipefail
if [ "$(uname -s)" != Darwin ]; then
  echo "macos-release.sh makes the macOS disk image and runs only on macOS, not on $(uname -s)." >&2
  exit 1
fi
cd "$(dirname "$0")/.."
fail() {
  echo "macos-release.sh: $*" >&2
  exit 1
}

qt=${QT_PREFIX:-}
identity=${CODESIGN_IDENTITY:-}
profile=${NOTARY_PROFILE:-}
[ -n "$qt" ] || fail "set QT_PREFIX to Qt 6 for macOS, e.g. QT_PREFIX=~/Qt/6.8.3/macos"
[ -x "$qt/bin/macdeployqt" ] || fail "no $qt/bin/macdeployqt: QT_PREFIX is not Qt 6 for macOS"
qtArchs=$(lipo -archs "$qt/lib/QtCore.framework/QtCore") || fail "no QtCore framework in $qt/lib"
[[ " $qtArchs " == *" arm64 "* && " $qtArchs " == *" x86_64 "* ]] ||
  fail "Qt at $qt is built for $qtArchs only; a universal bundle needs a universal Qt"
[ -z "$profile" ] || [ -n "$identity" ] ||
  fail "NOTARY_PROFILE needs CODESIGN_IDENTITY: the notary service takes only Developer ID code"
if [ -n "$identity" ] && [ -n "$(git status --porcelain)" ]; then
  fail "the work tree has changes; a signed release is made from a clean checkout"
fi
echo "== from $(git describe --always --dirty), with Qt at $qt"

echo "== 1. build, arm64 and x86_64"
build="build-macos-release"
rm -rf "$build"
cmake -S . -B "$build" -DCMAKE_BUILD_TYPE=Release -DORBELANE_TESTS=OFF -DORBELANE_BENCH=OFF \
  -DCMAKE_PREFIX_PATH="$qt" -DCMAKE_OSX_ARCHITECTURES="arm64;x86_64"
cmake --build "$build" -j"$(sysctl -n hw.ncpu)"
app="$build/Orbelane Verification Storage.app"
archs=$(lipo -archs "$app/Contents/MacOS/Orbelane Verification Storage")
[[ " $archs " == *" arm64 "* && " $archs " == *" x86_64 "* ]] ||
  fail "the executable holds $archs only"
echo "executable: $archs"

echo "== 2. macdeployqt"
"$qt/bin/macdeployqt" "$app" -always-overwrite

echo "== 3. sign"
if [ -n "$identity" ]; then
  # The hardened runtime and a secure timestamp: what the notary service asks of all code.
  sign() { codesign --force --sign "$identity" --options runtime --timestamp "$@"; }
else
  echo "No CODESIGN_IDENTITY: signing ad hoc; the image will be neither signed nor notarised."
  # No identity, so no timestamp; and no hardened runtime, whose library validation refuses
  # frameworks signed ad hoc, which belong to no team.
  sign() { codesign --force --sign - "$@"; }
fi
while IFS= read -r -d '' library; do
  sign "$library"
done < <(find "$app/Contents/PlugIns" "$app/Contents/Frameworks" -name '*.dylib' -type f -print0)
while IFS= read -r -d '' framework; do
  sign "$framework"
done < <(find "$app/Contents/Frameworks" -maxdepth 1 -name '*.framework' -print0)
for item in "$app/Contents/Resources"/*; do
  if [ -f "$item/Contents/Info.plist" ]; then
    sign "$item"
  fi
done
sign "$app"
codesign --verify --deep --strict --verbose=2 "$app"

echo "== 4. disk image"
version=$(plutil -extract CFBundleShortVersionString raw -o - "$app/Contents/Info.plist")
dmg="$build/Orbelane-Verification-Storage-$version.dmg"
[ -n "$identity" ] || dmg="$build/Orbelane-Verification-Storage-$version-unsigned.dmg"
stage="$build/disk-image"
mkdir "$stage"
ditto "$app" "$stage/$(basename "$app")"
ln -s /Applications "$stage/Applications"
hdiutil create -volname "Orbelane Verification Storage" -srcfolder "$stage" -fs HFS+ \
  -format UDZO -ov "$dmg"

if [ -z "$identity" ]; then
  echo "== made $dmg: signed ad hoc, not notarised; for testing only"
  exit 0
fi
echo "== 5. sign the disk image"
codesign --force --sign "$identity" --timestamp "$dmg"
codesign --verify --verbose=2 "$dmg"

if [ -z "$profile" ]; then
  echo "== made $dmg: signed, not notarised (no NOTARY_PROFILE)"
  exit 0
fi
echo "== 6. notarise and staple"
result=$(xcrun notarytool submit "$dmg" --keychain-profile "$profile" --wait \
  --output-format json) || true
echo "$result"
status=$(plutil -extract status raw -o - - <<< "$result" 2> /dev/null || true)
if [ "$status" != Accepted ]; then
  id=$(plutil -extract id raw -o - - <<< "$result" 2> /dev/null || true)
  [ -z "$id" ] || xcrun notarytool log "$id" --keychain-profile "$profile"
  fail "the notary service did not accept $dmg (status: ${status:-none})"
fi
xcrun stapler staple "$dmg"
xcrun stapler validate "$dmg"
spctl --assess --type open --context context:primary-signature --verbose "$dmg"
echo "== made $dmg: signed, notarised and stapled"
