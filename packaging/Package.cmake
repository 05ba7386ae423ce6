# What an installed Vennick needs besides the program and its resources: the
# manual page, the copyright and the changelog; and the Debian package that
# CPack makes of the whole install (scripts/package.sh).

# The release notes carry the version too; they must name the one project() sets.
file(STRINGS ${CMAKE_CURRENT_LIST_DIR}/changelog changelog_top LIMIT_COUNT 1)
if(NOT changelog_top MATCHES "^vennick \\(${PROJECT_VERSION}\\) ")
    message(FATAL_ERROR "packaging/changelog does not begin with version ${PROJECT_VERSION}: ${changelog_top}")
endif()
file(READ ${PROJECT_SOURCE_DIR}/resources/org.quorvan.Vennick.metainfo.xml metainfo)
if(NOT metainfo MATCHES "<release version=\"${PROJECT_VERSION}\"")
    message(FATAL_ERROR "The metainfo's latest release is not version ${PROJECT_VERSION}")
endif()

# Manual pages and changelogs are installed compressed, as Debian wants them;
# without a name or time in the header, the same text gives the same bytes.
find_program(VENNICK_GZIP gzip REQUIRED)
set(VENNICK_PACKAGING_DIR ${CMAKE_BINARY_DIR}/packaging)
file(MAKE_DIRECTORY ${VENNICK_PACKAGING_DIR})
foreach(text vennick.6 changelog)
    execute_process(COMMAND ${VENNICK_GZIP} -9 -n -c ${CMAKE_CURRENT_LIST_DIR}/${text}
                    OUTPUT_FILE ${VENNICK_PACKAGING_DIR}/${text}.gz
                    COMMAND_ERROR_IS_FATAL ANY)
    set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${CMAKE_CURRENT_LIST_DIR}/${text})
endforeach()

install(FILES ${VENNICK_PACKAGING_DIR}/vennick.6.gz DESTINATION ${CMAKE_INSTALL_MANDIR}/man6)
# In share/doc/<package>, where Debian wants them (GNUInstallDirs' DOCDIR
# would take the project's capital V).
install(FILES ${CMAKE_CURRENT_LIST_DIR}/copyright ${VENNICK_PACKAGING_DIR}/changelog.gz
        DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/vennick)

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME vennick)
set(CPACK_PACKAGE_VENDOR Quorvan)
set(CPACK_PACKAGE_CONTACT "Quorvan <dev@vennick.invalid>")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "cribbage game against the computer")
set(CPACK_PACKAGE_DESCRIPTION [[
Vennick is a game of cribbage for two: you against the computer. Each
hand deals six cards, two go to the crib, the starter is turned, the
cards are played to 31 and every hand is counted in the show, with each
point pegged on a 121-hole board.

The window takes the largest whole scale that fits the screen, so the
cards and the board stay crisp. The match tally is kept from one game
to the next, and the board can be drawn in three styles.]])
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION games)
set(CPACK_DEBIAN_PACKAGE_PRIORITY optional)
# The libraries the program links, from dpkg-shlibdeps, and the platform
# plugins Qt loads at run time, without which no window opens.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_DEPENDS qt6-qpa-plugins)
set(CPACK_STRIP_FILES ON)
# Folders the install creates get Debian's 0755, whatever the umask.
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
    OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
include(CPack)
