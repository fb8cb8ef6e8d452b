#!/usr/bin/env bash
# Renders the SVG drawings beside this script and packs each into an .ico. Size 16 comes from <name>.16.svg, all other
# sizes from <name>.svg. Needs librsvg2-bin and icoutils.
set -euo pipefail

cd -- "$(dirname -- "${BASH_SOURCE[0]}")"

tmp=$(mktemp -d)
trap 'rm -rf -- "$tmp"' EXIT

for name in *.16.svg; do
  name=${name%.16.svg}
  for size in 16 32 48 256; do
    src=$name.svg
    [ "$size" -ne 16 ] || src=$name.16.svg
    rsvg-convert -w "$size" -h "$size" -o "$tmp/$size.png" "$src"
  done
  # Force 32 bits, because icotool would use a palette for few colours; size 256 stays PNG.
  icotool -c -b 32 -o "$tmp/$name.ico" \
    "$tmp/16.png" "$tmp/32.png" "$tmp/48.png" -r "$tmp/256.png"
  mv -- "$tmp/$name.ico" "$name.ico"
done
