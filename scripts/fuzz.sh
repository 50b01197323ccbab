#!/usr/bin/env bash
# Fuzzes the picture header reader with clang's libFuzzer (address and undefined-behaviour
# sanitizers on), seeded with the test pictures, for a minute by default.
#
#   scripts/fuzz.sh [seconds]
#
# Builds in build-fuzz/ (or $ZORBIN_FUZZ_BUILD_DIR) only what the fuzz target and its seeds
# need. A crash, hang or sanitizer report fails the script and leaves the input that caused it
# in build-fuzz/fuzz/artifacts/: add it to tests/images as a regression test.
set -euo pipefail

root=$(cd "$(dirname "$0")/.." && pwd)
build=${ZORBIN_FUZZ_BUILD_DIR:-$root/build-fuzz}
seconds=${1:-60}

cmake -S "$root" -B "$build" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo \
    -DCMAKE_CXX_COMPILER=clang++-14 -DZORBIN_BUILD_FUZZ=ON -DZORBIN_BUILD_TESTS=ON -DZORBIN_BUILD_BENCH=OFF \
    >/dev/null
cmake --build "$build" --target picture-header-fuzzer image-test-pictures

# The seeds: the test pictures, each cut to the first 64 kB (a header lies there; the wide
# bitmap's pixels only slow the fuzzer down). The corpus grows in its own folder between runs.
seeds="$build/fuzz/seeds"
corpus="$build/fuzz/corpus"
artifacts="$build/fuzz/artifacts"
rm -rf "$seeds"
mkdir -p "$seeds" "$corpus" "$artifacts"
for picture in "$build"/tests/images/pictures/*; do
    head -c 65536 "$picture" >"$seeds/$(basename "$picture")"
done

echo "Fuzzing the picture header reader for $seconds seconds"
"$build/fuzz/picture-header-fuzzer" "$corpus" "$seeds" \
    -max_total_time="$seconds" -max_len=70000 -timeout=10 -rss_limit_mb=2048 \
    -artifact_prefix="$artifacts/" -print_final_stats=1
