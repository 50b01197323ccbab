#!/usr/bin/env bash
# Writes the demo catalog and a picture of its first page as Debian's Chromium shows it.
#
# Usage: tests/browser/screenshot-demo.sh [PNG]   (default docs/screenshots/demo-catalog.png)
# Needs a build (BUILD_DIR, default build) and the chromium package.
set -euo pipefail
cd "$(dirname "$0")/../.."
build=${BUILD_DIR:-build}
png=${1:-docs/screenshots/demo-catalog.png}
mkdir -p "$(dirname "$png")"
png=$(cd "$(dirname "$png")" && pwd)/$(basename "$png")

work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
# A temporary folder of its own, so that the demo's working database stays out of the user's.
TMPDIR="$work" "$build/src/cli/zorbin-cli" demo --out "$work/catalog" >/dev/null
chromium --headless --no-sandbox --disable-gpu --no-first-run --disable-background-networking \
    --disable-component-update --disable-sync --user-data-dir="$work/profile" --hide-scrollbars \
    --window-size="${SCREENSHOT_SIZE:-1000,1000}" --screenshot="$png" "file://$work/catalog/zoindex.htm" \
    2>/dev/null
echo "$png"
