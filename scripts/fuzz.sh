#!/usr/bin/env bash
# Fuzzes the parsers with clang's libFuzzer (address and undefined-behaviour sanitizers on):
# the picture header reader, seeded with the test pictures, for a minute by default, then the
# connection-string parser and the translation of Boolean literals in SQL text, for half as long
# each.
#
#   scripts/fuzz.sh [seconds]
#
# Builds in build-fuzz/ (or $ZORBIN_FUZZ_BUILD_DIR) only what the fuzz targets and their seeds
# need. A crash, hang or sanitizer report fails the script and leaves the input that caused it
# in build-fuzz/fuzz/artifacts/: add it to the tests of that parser as a regression test.
set -euo pipefail

root=$(cd "$(dirname "$0")/.." && pwd)
build=${ZORBIN_FUZZ_BUILD_DIR:-$root/build-fuzz}
seconds=${1:-60}

cmake -S "$root" -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
    -DCMAKE_CXX_COMPILER=clang++-14 -DZORBIN_BUILD_FUZZ=ON -DZORBIN_BUILD_TESTS=ON -DZORBIN_BUILD_BENCH=OFF \
    >/dev/null
cmake --build "$build" --target picture-header-fuzzer connection-string-fuzzer boolean-literals-fuzzer \
    image-test-pictures

artifacts="$build/fuzz/artifacts"
mkdir -p "$artifacts"

# fuzz <target> <seconds> <seed folder> [libFuzzer options...]: the corpus grows in its own folder
# between runs.
fuzz() {
    local target=$1 time=$2 seeds=$3
    shift 3
    local corpus="$build/fuzz/corpus-$target"
    mkdir -p "$corpus"
    echo "Fuzzing $target for $time seconds"
    "$build/fuzz/$target" "$corpus" "$seeds" -max_total_time="$time" -timeout=10 -rss_limit_mb=2048 \
        -artifact_prefix="$artifacts/$target-" -print_final_stats=1 "$@"
}

# The picture seeds: the test pictures, each cut to the first 64 kB (a header lies there; the
# wide bitmap's pixels only slow the fuzzer down).
seeds="$build/fuzz/seeds-pictures"
rm -rf "$seeds"
mkdir -p "$seeds"
for picture in "$build"/tests/images/pictures/*; do
    head -c 65536 "$picture" >"$seeds/$(basename "$picture")"
done
fuzz picture-header-fuzzer "$seconds" "$seeds" -max_len=70000

# The text seeds: connection strings of each kind, and the catalog's own statements.
seeds="$build/fuzz/seeds-texts"
rm -rf "$seeds"
mkdir -p "$seeds"
printf '%s' 'driver={SQL Server};server=db1;uid=shop;pwd={a;b}}c};database=stock' >"$seeds/odbc"
printf '%s' "Provider=sqloledb;Data Source=srv;User Id=sa;Password=\"x\"\"y\";Initial Catalog=d" >"$seeds/oledb"
printf 'shop\nsem;i}co{lon' >"$seeds/login"
printf '%s' "SELECT ItemKey FROM tItems WHERE Include = True And Name <> 'True' -- False" >"$seeds/sql"
printf '%s' 'SELECT [False], "true" FROM t /* TRUE */ WHERE x = FALSE' >"$seeds/sql-quoted"
fuzz connection-string-fuzzer $((seconds / 2)) "$seeds" -max_len=512
fuzz boolean-literals-fuzzer $((seconds / 2)) "$seeds" -max_len=512
