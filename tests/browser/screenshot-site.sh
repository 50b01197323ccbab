#!/usr/bin/env bash
# Writes the demo's web catalog and pictures of its first page as Debian's Chromium shows it on
# a phone (390 x 844) and on a wide screen (1280 x 800).
#
# Usage: tests/browser/screenshot-site.sh [FOLDER]   (default docs/screenshots: web-phone.png, web-wide.png)
# Needs a build (BUILD_DIR, default build) and the chromium package.
set -euo pipefail
cd "$(dirname "$0")/../.."
build=${BUILD_DIR:-build}
folder=${1:-docs/screenshots}
mkdir -p "$folder"
folder=$(cd "$folder" && pwd)

work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
# A temporary folder of its own, so that the demo's working database stays out of the user's.
TMPDIR="$work" "$build/src/cli/zorbin-cli" web --settings "$build/demo/demo-settings.ini" --out "$work/site" >/dev/null
for shot in phone:390,844 wide:1280,800; do
    TMPDIR=/tmp chromium --headless --no-sandbox --disable-gpu --no-first-run --disable-background-networking \
        --disable-component-update --disable-sync --user-data-dir="$work/profile" --hide-scrollbars \
        --window-size="${shot#*:}" --screenshot="$folder/web-${shot%%:*}.png" "file://$work/site/index.html" \
        2>/dev/null
    echo "$folder/web-${shot%%:*}.png"
done
