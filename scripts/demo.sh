#!/usr/bin/env bash
# The demo catalog from a fresh machine: packages, build, then the catalog of the bundled demo
# database in ./catalog-demo (pass --open to see it in a browser window).
set -euo pipefail
cd "$(dirname "$0")/.."
scripts/install-deps.sh
scripts/build.sh
"${BUILD_DIR:-build}/src/cli/zorbin-cli" demo --out catalog-demo "$@"
