#!/usr/bin/env bash
# Writes the demo catalog as a PDF and a picture of its first page at 60 dpi.
#
# Usage: tests/pdf/screenshot-demo-pdf.sh [PNG]   (default docs/screenshots/demo-catalog-pdf.png)
# Needs a build (BUILD_DIR, default build) and poppler-utils.
set -euo pipefail
cd "$(dirname "$0")/../.."
build=${BUILD_DIR:-build}
png=${1:-docs/screenshots/demo-catalog-pdf.png}
mkdir -p "$(dirname "$png")"
png=$(cd "$(dirname "$png")" && pwd)/$(basename "$png")

work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
# A temporary folder of its own, so that the demo's working database stays out of the user's.
TMPDIR="$work" "$build/src/cli/zorbin-cli" pdf --settings "$build/demo/demo-settings.ini" \
    --out "$work/demo.pdf" >/dev/null 2>&1
pdftoppm -png -r 60 -f 1 -l 1 -singlefile "$work/demo.pdf" "${png%.png}"
echo "$png"
