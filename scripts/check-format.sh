#!/usr/bin/env bash
# Fails when a C++ file of the repository differs from what the project's .clang-format makes
# of it, and names the files. `scripts/check-format.sh --fix` formats them in place.
set -euo pipefail
cd "$(dirname "$0")/.."
format=$(command -v clang-format-14 || command -v clang-format)
mapfile -t files < <(git ls-files '*.cpp' '*.h')
if [ "${1:-}" = "--fix" ]; then
    "$format" -i "${files[@]}"
    exit 0
fi
"$format" --dry-run --Werror "${files[@]}"
echo "All ${#files[@]} C++ files are formatted."
