#!/bin/sh
# Regenerates the README previews in docs/art from a built discart and discart_preview.
# usage: tools/discart/make_previews.sh <directory holding discart and discart_preview>
set -eu
bin=${1:?usage: make_previews.sh <directory holding discart and discart_preview>}
root=$(cd "$(dirname "$0")/../.." && pwd)
out="$root/docs/art"
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT

"$bin/discart" resources "$work/art"
"$bin/discart" backgrounds "$work/art"
mkdir -p "$work/sheets" "$out"
"$bin/discart_preview" "$work/art" "$work/sheets"

png() {
    convert "$1" -strip -define png:compression-level=9 -define png:compression-filter=5 "$out/$2"
}
png "$work/art/AutoPlayBack.bmp" background-en.png
png "$work/art/AutoPlayBackJp.bmp" background-ja.png
png "$work/art/AutoPlayBackTh.bmp" background-th.png
png "$work/art/bitmap_377.bmp" language-list.png
png "$work/art/bitmap_241.bmp" about.png
png "$work/sheets/buttons.bmp" buttons.png
png "$work/sheets/plates.bmp" plates.png
png "$work/sheets/mockup-main.bmp" mockup-main.png
png "$work/sheets/mockup-panel.bmp" mockup-panel.png
png "$work/sheets/mockup-list.bmp" mockup-list.png
ls -l "$out"
