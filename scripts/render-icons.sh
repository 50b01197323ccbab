#!/usr/bin/env bash
# Renders the program's icon (data/icons/zorbin.svg) into the PNG sizes that are installed beside
# it and built into the program. Needs rsvg-convert (Debian's librsvg2-bin); run after changing the SVG.
set -euo pipefail
cd "$(dirname "$0")/../data/icons"
for size in 48 256; do
    rsvg-convert -w "$size" -h "$size" zorbin.svg -o "zorbin-$size.png"
done
