# The Debian package, through CPack's DEB generator. In a build folder configured with
# -DCMAKE_INSTALL_PREFIX=/usr, `cpack` writes zorbin_VERSION-RELEASE_ARCH.deb with what
# `cmake --install` installs (both programs, the menu entry and icons, the demo database) and the
# files below: AppStream metadata, the manual pages, the copyright file and the Debian changelog.
# scripts/package.sh configures, builds and packages into dist/.
#
# The version is the project's (project(VERSION) in the top CMakeLists.txt); the programs print it.

set(ZORBIN_PACKAGE_RELEASE "1" CACHE STRING "The Debian revision of the package (the part after the version)")
set(ZORBIN_PACKAGE_MAINTAINER "Zorbin maintainers <maintainers@zorbin.example>"
    CACHE STRING "The Maintainer field of the Debian package: name <address>")

if(NOT CMAKE_INSTALL_PREFIX STREQUAL "/usr")
    message(STATUS "Packaging: the Debian package installs into /usr, but this build refers to "
                   "${CMAKE_INSTALL_PREFIX}; configure with -DCMAKE_INSTALL_PREFIX=/usr to package it")
endif()

# Dates of the release: SOURCE_DATE_EPOCH when set (scripts/package.sh takes the last commit's).
string(TIMESTAMP ZORBIN_RELEASE_DATE "%Y-%m-%d" UTC)
string(TIMESTAMP ZORBIN_RELEASE_TIME "%a, %d %b %Y %H:%M:%S +0000" UTC)

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME zorbin)
set(CPACK_PACKAGE_VENDOR "Tarnik Information Systems")
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_CONTACT "${ZORBIN_PACKAGE_MAINTAINER}")
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "Hebrew HTML product catalog from an accounting database")
set(CPACK_PACKAGE_DESCRIPTION
    "Zorbin turns the item master data of a small business's accounting\n"
    "database into a static HTML product catalog in Hebrew, right to left:\n"
    "pages of rows by columns of item cells, each a picture and up to nine\n"
    "formatted lines (name, key, category, two prices, unit, two extra notes),\n"
    "under a titled top band with a logo and above a bottom band with page\n"
    "links, with a generated stylesheet and a plain item list.\n"
    "\n"
    "The accounting database is an SQL Server reached through ODBC (FreeTDS),\n"
    "or a Jet, Access or SQLite database file, and it is only read. The\n"
    "package holds the desktop program zorbin, the command-line program\n"
    "zorbin-cli and a demo database to try them on.")
string(JOIN "" CPACK_PACKAGE_DESCRIPTION ${CPACK_PACKAGE_DESCRIPTION})

set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_RELEASE ${ZORBIN_PACKAGE_RELEASE})
set(CPACK_DEBIAN_PACKAGE_MAINTAINER "${ZORBIN_PACKAGE_MAINTAINER}")
set(CPACK_DEBIAN_PACKAGE_SECTION misc)
set(CPACK_DEBIAN_PACKAGE_PRIORITY optional)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
# The libraries the programs link, from dpkg-shlibdeps; the Qt database plugins are loaded at run
# time (the working database is SQLite, the accounting database is reached through ODBC), so they
# are named here. The ODBC drivers for the accounting database and the catalog's Hebrew fonts are
# recommended; a browser for --open.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_DEPENDS "libqt6sql6-sqlite, libqt6sql6-odbc")
set(CPACK_DEBIAN_PACKAGE_RECOMMENDS "odbc-postgresql, tdsodbc, libsqliteodbc, odbc-mdbtools, culmus")
set(CPACK_DEBIAN_PACKAGE_SUGGESTS "chromium | xdg-utils")
set(ZORBIN_DEB_VERSION "${PROJECT_VERSION}-${ZORBIN_PACKAGE_RELEASE}") # as dpkg shows it

find_program(ZORBIN_GZIP gzip REQUIRED)
set(package_dir ${CMAKE_BINARY_DIR}/package)
set(package_doc_dir ${CMAKE_INSTALL_DATADIR}/doc/zorbin)

# gzip_for_install(<file> <destination>): installs <file>.gz, compressed at build time without a
# time stamp (as Debian wants its manual pages and changelogs).
set(package_compressed)
function(gzip_for_install file destination)
    add_custom_command(OUTPUT ${file}.gz
        COMMAND ${ZORBIN_GZIP} -9 -n -f -k ${file}
        DEPENDS ${file}
        VERBATIM)
    install(FILES ${file}.gz DESTINATION ${destination})
    set(package_compressed ${package_compressed} ${file}.gz PARENT_SCOPE)
endfunction()

# Manual pages, with the version and the demo folder filled in.
foreach(page zorbin.1 zorbin-cli.1)
    configure_file(${PROJECT_SOURCE_DIR}/data/man/${page} ${package_dir}/man/${page} @ONLY)
    gzip_for_install(${package_dir}/man/${page} ${CMAKE_INSTALL_MANDIR}/man1)
endforeach()

# The Debian changelog of this package version, and the copyright file.
configure_file(${PROJECT_SOURCE_DIR}/data/debian/changelog.in ${package_dir}/changelog.Debian @ONLY)
gzip_for_install(${package_dir}/changelog.Debian ${package_doc_dir})
install(FILES ${PROJECT_SOURCE_DIR}/data/debian/copyright DESTINATION ${package_doc_dir})
add_custom_target(zorbin-package-files ALL DEPENDS ${package_compressed})

# AppStream metadata, for software centres.
set(ZORBIN_METAINFO org.zorbin.zorbin.metainfo.xml)
configure_file(${PROJECT_SOURCE_DIR}/data/zorbin.metainfo.xml.in ${package_dir}/${ZORBIN_METAINFO} @ONLY)
install(FILES ${package_dir}/${ZORBIN_METAINFO} DESTINATION ${CMAKE_INSTALL_DATADIR}/metainfo)
find_program(ZORBIN_APPSTREAMCLI appstreamcli)
if(ZORBIN_BUILD_TESTS AND ZORBIN_APPSTREAMCLI)
    add_test(NAME package-metainfo COMMAND ${ZORBIN_APPSTREAMCLI} validate --no-net ${package_dir}/${ZORBIN_METAINFO})
endif()

include(CPack)
