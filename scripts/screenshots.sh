#!/usr/bin/env bash
# Takes the README's screenshots: runs the end-to-end tests of a build that save screens (each
# language's background, the language lists, the main menus, the panels, a hovered button, the
# About box) with the launcher on its sample disc under Wine, and turns them into PNG files.
#   screenshots.sh BUILD_DIR [OUT_DIR]
set -euo pipefail
build=$(cd "$1" && pwd)
here=$(cd "$(dirname "$0")/.." && pwd)
out=${2:-$here/docs/screenshots}
STATE="$build/screenshots-wine"
shots="$build/screenshots"
rm -rf "$shots"
mkdir -p "$shots" "$out"
"$here/tests/wine/prefix.sh" setup "$STATE" >/dev/null
trap '"$here/tests/wine/prefix.sh" cleanup "$STATE" >/dev/null 2>&1 || true' EXIT
AUTOPLAY_SCREENSHOT_DIR="Z:${shots//\//\\}" "$here/tests/wine/run.sh" "$STATE" \
    "$build/bin/e2e_tests.exe" --gtest_filter='Screens.*:Menu.Each*:Menu.TheMouse*:Commands.AboutBoxShows*' | grep -E '^\[ *(OK|FAILED|PASSED) '
# The saved shots' fourth byte is not transparency (a focus rectangle leaves stray values in it).
for shot in "$shots"/*.bmp; do
    convert "$shot" -alpha off -strip "$out/$(basename "${shot%.bmp}").png"
done
ls "$out"
