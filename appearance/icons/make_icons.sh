#!/usr/bin/env bash
# Renders the SVG drawings beside this script and packs each into an .ico. Size 16 comes from <name>.16.svg, all other
# sizes from <name>.svg. It also makes the README's picture of all four. Needs librsvg2-bin and icoutils.
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

captions=(enabled disabled 'enabled, in error' 'disabled, in error')
drawn='width="256" height="256"'
shown='width="64" height="64"'
left=0
{
  echo '<svg xmlns="http://www.w3.org/2000/svg" width="600" height="104" font-family="DejaVu Sans" font-size="13">'
  echo '<rect width="100%" height="100%" fill="#fff"/>'
  for name in hf_folder hf_folder_disabled hf_error_active hf_error_inactive; do
    echo "<svg x='$((left + 43))' y='8'>$(sed "/<?xml/d; s/$drawn/$shown/" $name.svg)</svg>"
    echo "<text x='$((left + 75))' y='93' text-anchor='middle'>${captions[left / 150]}</text>"
    left=$((left + 150))
  done
  echo '</svg>'
} >"$tmp/icons.svg"
rsvg-convert -o ../../docs/icons.png "$tmp/icons.svg"
