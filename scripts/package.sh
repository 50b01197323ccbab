#!/usr/bin/env bash
# Builds the Debian package into dist/: the Debian packages it needs, a build in build-package/
# (or $PACKAGE_BUILD_DIR) for the prefix /usr with Debian's compiler and linker flags, CPack's
# DEB generator, then lintian, which fails the script on any error. Extra arguments go to cmake.
#
#   scripts/package.sh [cmake options]    then: sudo apt-get install ./dist/zorbin_*.deb
set -euo pipefail
cd "$(dirname "$0")/.."
scripts/install-deps.sh

build_dir=${PACKAGE_BUILD_DIR:-build-package}
# Hardening and the other flags Debian builds its packages with (CMake reads no CPPFLAGS).
eval "$(DEB_BUILD_MAINT_OPTIONS=hardening=+all dpkg-buildflags --export=sh)"
export CXXFLAGS="${CXXFLAGS:-} ${CPPFLAGS:-}"
# The dates in the changelog and the AppStream metadata: the last commit's, so that a package
# built twice from one commit is the same.
SOURCE_DATE_EPOCH=${SOURCE_DATE_EPOCH:-$(git log -1 --format=%ct 2>/dev/null || date +%s)}
export SOURCE_DATE_EPOCH

cmake -S . -B "$build_dir" -G Ninja -DCMAKE_BUILD_TYPE=RelWithDebInfo -DCMAKE_INSTALL_PREFIX=/usr \
    -DZORBIN_BUILD_TESTS=OFF -DZORBIN_BUILD_BENCH=OFF "$@"
cmake --build "$build_dir" --parallel "$(nproc)"

rm -f "$build_dir"/zorbin_*.deb
(cd "$build_dir" && cpack -G DEB)
mkdir -p dist
rm -f dist/zorbin_*.deb
mv "$build_dir"/zorbin_*.deb dist/
package=$(ls dist/zorbin_*.deb)

echo "Checking $package with lintian"
lintian --fail-on error "$package"
echo "$package"
