# SPDX-License-Identifier: MIT
# What is installed, and the Debian packages: zelmars (program, component, companions, desktop entry)
# and zelmars-doc. The shared objects are nobody else's, so they lie beside the program in a folder of
# their own, and only a link to the program is on the path.
include(GNUInstallDirs)

set(ZELMARS_HOME ${CMAKE_INSTALL_LIBDIR}/zelmars)
set(ZELMARS_DOC_DIR ${CMAKE_INSTALL_DATADIR}/doc/zelmars-doc)
set(ZELMARS_APP internal.zelmars.zelmars)
set(ZELMARS_SHARE ${CMAKE_SOURCE_DIR}/share)

get_property(delivered GLOBAL PROPERTY ZELMARS_DELIVERED)
install(TARGETS zelmars_host ${delivered}
    RUNTIME DESTINATION ${ZELMARS_HOME} COMPONENT program
    LIBRARY DESTINATION ${ZELMARS_HOME} COMPONENT program)
install(CODE "
    set(folder \"\$ENV{DESTDIR}\${CMAKE_INSTALL_PREFIX}/${CMAKE_INSTALL_BINDIR}\")
    file(MAKE_DIRECTORY \"\${folder}\")
    file(CREATE_LINK ../${ZELMARS_HOME}/zelmars \"\${folder}/zelmars\" SYMBOLIC)"
    COMPONENT program)

# zelmars_compressed(FILE NAME FOLDER): installs a file packed, without the hour, so that two builds
# are equal.
function(zelmars_compressed file name folder)
    set(packed ${CMAKE_BINARY_DIR}/share/${folder}/${name}.gz)
    install(CODE "
        file(MAKE_DIRECTORY ${CMAKE_BINARY_DIR}/share/${folder})
        execute_process(COMMAND gzip -9nc ${file} OUTPUT_FILE ${packed} COMMAND_ERROR_IS_FATAL ANY)"
        COMPONENT program)
    install(FILES ${packed} DESTINATION ${folder} COMPONENT program)
endfunction()

install(FILES ${ZELMARS_SHARE}/applications/${ZELMARS_APP}.desktop
    DESTINATION ${CMAKE_INSTALL_DATADIR}/applications COMPONENT program)
install(FILES ${ZELMARS_SHARE}/icons/${ZELMARS_APP}.svg
    DESTINATION ${CMAKE_INSTALL_DATADIR}/icons/hicolor/scalable/apps COMPONENT program)
install(FILES ${ZELMARS_SHARE}/metainfo/${ZELMARS_APP}.metainfo.xml
    DESTINATION ${CMAKE_INSTALL_DATADIR}/metainfo COMPONENT program)
install(FILES ${ZELMARS_SHARE}/zelmars.bash-completion RENAME zelmars
    DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions COMPONENT program)
zelmars_compressed(${ZELMARS_SHARE}/man/zelmars.1 zelmars.1 ${CMAKE_INSTALL_MANDIR}/man1)
zelmars_compressed(${ZELMARS_SHARE}/man/pt/zelmars.1 zelmars.1 ${CMAKE_INSTALL_MANDIR}/pt/man1)
install(FILES ${ZELMARS_SHARE}/debian/lintian-overrides RENAME zelmars
    DESTINATION ${CMAKE_INSTALL_DATADIR}/lintian/overrides COMPONENT program)
foreach(package zelmars zelmars-doc)
    set(folder ${CMAKE_INSTALL_DATADIR}/doc/${package})
    if(package STREQUAL zelmars)
        set(component program)
    else()
        set(component documents)
    endif()
    install(FILES ${ZELMARS_SHARE}/debian/copyright DESTINATION ${folder} COMPONENT ${component})
    set(packed ${CMAKE_BINARY_DIR}/share/changelog.gz)
    install(CODE "execute_process(COMMAND gzip -9nc ${ZELMARS_SHARE}/debian/changelog
        OUTPUT_FILE ${packed} COMMAND_ERROR_IS_FATAL ANY)" COMPONENT ${component})
    install(FILES ${packed} DESTINATION ${folder} COMPONENT ${component})
endforeach()
install(FILES README.md CHANGELOG.md DESTINATION ${ZELMARS_DOC_DIR} COMPONENT documents)
install(DIRECTORY docs DESTINATION ${ZELMARS_DOC_DIR} COMPONENT documents)
# Once set-up/manual has built it.
install(DIRECTORY build/manual/ DESTINATION ${ZELMARS_DOC_DIR} COMPONENT documents OPTIONAL)

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME zelmars)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_CONTACT "The Zelmars authors <zelmars@example.org>")
set(CPACK_PACKAGE_DIRECTORY ${CMAKE_SOURCE_DIR}/build/package)
set(CPACK_COMPONENTS_ALL program documents)
set(CPACK_STRIP_FILES ON)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ
    GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PROGRAM_PACKAGE_NAME zelmars)
set(CPACK_DEBIAN_PROGRAM_PACKAGE_SECTION misc)
set(CPACK_DEBIAN_PROGRAM_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${CMAKE_BINARY_DIR}/bin)
# What no library names: the toolkit's way to the display, its Portuguese, the faces of screens and
# paper, and the print queue's library, which is looked for when something is printed.
set(CPACK_DEBIAN_PROGRAM_PACKAGE_DEPENDS "qt6-qpa-plugins, qt6-translations-l10n, fonts-dejavu-core, fonts-liberation")
# The manual is in the program; its pictures are in the documents.
set(CPACK_DEBIAN_PROGRAM_PACKAGE_RECOMMENDS "libcups2, postgresql-client, sqlite3, zelmars-doc")
set(CPACK_COMPONENT_PROGRAM_DESCRIPTION "books of a collective health plan
Zelmars keeps the books of a health plan that a members' organisation runs
for its members and their families: documents and hospital bills, what the
plan pays of them, receipts, payments, letters, declarations, the year close.
Its screens are in Portuguese.")
set(CPACK_DEBIAN_DOCUMENTS_PACKAGE_NAME zelmars-doc)
set(CPACK_DEBIAN_DOCUMENTS_PACKAGE_SECTION doc)
set(CPACK_DEBIAN_DOCUMENTS_PACKAGE_ARCHITECTURE all)
set(CPACK_COMPONENT_DOCUMENTS_DESCRIPTION "documents of the health plan's books
What the screens' keys are, how a server is set up, how files are imported
and payments made with Zelmars. In Portuguese.")
include(CPack)
