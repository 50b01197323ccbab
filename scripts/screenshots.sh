#!/usr/bin/env bash
# Pictures of the desktop program (each tab, the connection dialog, the item selection dialog)
# under a virtual display, into docs/screenshots/. Builds first; needs xvfb (scripts/install-deps.sh).
set -euo pipefail
cd "$(dirname "$0")/.."
build_dir=${BUILD_DIR:-build}
scripts/build.sh >/dev/null
cmake --build "$build_dir" --target zorbin-screenshots >/dev/null
# A demo database in a short, plain folder, so that the paths in the pictures read well; the
# item selection picture collects its items into a working database of its own.
demo_dir=/tmp/zorbin-demo
work_dir=$(mktemp -d)
trap 'rm -rf "$work_dir" "$demo_dir"' EXIT
rm -rf "$demo_dir"
bash demo/make-demo-db.sh "$demo_dir" >/dev/null
TMPDIR=$work_dir xvfb-run -a -s "-screen 0 1280x900x24" "$build_dir/tools/screenshots/zorbin-screenshots" \
    docs/screenshots "$demo_dir/demo-settings.ini"
