#!/usr/bin/env bash
# Installs every Debian package that building, the demo and the tests need (Debian 12).
set -euo pipefail

packages=(
    # build
    build-essential cmake ninja-build pkg-config
    qt6-base-dev qt6-base-dev-tools libqt6sql6-sqlite libqt6sql6-odbc libgl-dev
    libicu-dev libsqlite3-dev unixodbc unixodbc-dev
    # the accounting database: ODBC drivers, mdbtools for Jet and Access files
    libsqliteodbc odbc-postgresql tdsodbc mdbtools odbc-mdbtools
    # the demo database and its pictures
    sqlite3 imagemagick
    # tests: a PostgreSQL server behind the ODBC driver, a virtual display, a real browser, fuzzing
    postgresql xvfb xauth chromium clang clang-format libclang-rt-14-dev
    # the catalog's Hebrew fonts (David, Miriam) and a font for the settings page
    culmus fonts-dejavu-core
    # the Debian package (scripts/package.sh): CPack's dependency lookup, its checks, manual pages
    dpkg-dev file lintian appstream man-db
    # the PDF catalog: Liberation Sans draws the pages' Arial (with its Hebrew letters); poppler-utils
    # reads the PDF back in the tests
    fonts-liberation2 poppler-utils
)

run() {
    if [ "$(id -u)" -eq 0 ]; then "$@"; else sudo "$@"; fi
}

missing=()
for package in "${packages[@]}"; do
    dpkg-query -W -f='${Status}' "$package" 2>/dev/null | grep -q 'install ok installed' || missing+=("$package")
done
if [ "${#missing[@]}" -eq 0 ]; then
    echo "All Debian packages are installed."
    exit 0
fi
run apt-get update
run env DEBIAN_FRONTEND=noninteractive apt-get install -y --no-install-recommends "${missing[@]}"
