# What `cmake --install` puts where.
include(GNUInstallDirs)
set(DORBO_DOCS ${CMAKE_INSTALL_DATADIR}/doc/dorbo)

install(TARGETS dorbo toon_tool RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
get_target_property(DORBO_TOON_FILES toons TOONS)
install(FILES ${DORBO_TOON_FILES} DESTINATION ${CMAKE_INSTALL_DATADIR}/dorbo/toons)

# Launchers, and where hosts of savers look for theirs.
install(TARGETS dorbo_start RUNTIME DESTINATION ${CMAKE_INSTALL_LIBEXECDIR}/dorbo)
install(TARGETS dorbo_hack RUNTIME DESTINATION ${CMAKE_INSTALL_LIBEXECDIR}/xscreensaver)
install(FILES launch/dorbo-hack.xml DESTINATION ${CMAKE_INSTALL_DATADIR}/xscreensaver/config)

# add_packed(FILE DIRECTORY NAME): installs a file packed, without name and time, so that the same
# file gives the same bytes.
find_program(GZIP gzip REQUIRED)
function(add_packed file directory name)
    set(packed ${PROJECT_BINARY_DIR}/packaging/${name}.gz)
    add_custom_command(OUTPUT ${packed} DEPENDS ${file}
        COMMAND ${GZIP} -9nc ${file} > ${packed} VERBATIM)
    add_custom_target(packed-${name} ALL DEPENDS ${packed})
    install(FILES ${packed} DESTINATION ${directory})
endfunction()

file(MAKE_DIRECTORY ${PROJECT_BINARY_DIR}/packaging)
add_packed(${PROJECT_SOURCE_DIR}/docs/dorbo.6 ${CMAKE_INSTALL_MANDIR}/man6 dorbo.6)
add_packed(${PROJECT_SOURCE_DIR}/docs/toon.1 ${CMAKE_INSTALL_MANDIR}/man1 toon.1)
add_packed(${PROJECT_SOURCE_DIR}/packaging/changelog ${DORBO_DOCS} changelog)

# Icons of the program and of its files.
foreach(size 16 22 24 32 48 64 128 256)
    set(icons ${CMAKE_INSTALL_DATADIR}/icons/hicolor/${size}x${size})
    install(FILES resources/icons/${size}.png DESTINATION ${icons}/apps RENAME dorbo.png)
    install(FILES resources/icons/toon-${size}.png DESTINATION ${icons}/mimetypes
        RENAME application-x-dorbo-toon.png)
endforeach()
set(icons ${CMAKE_INSTALL_DATADIR}/icons/hicolor/scalable)
install(FILES resources/icons/dorbo.svg DESTINATION ${icons}/apps)
install(FILES resources/icons/toon.svg DESTINATION ${icons}/mimetypes
    RENAME application-x-dorbo-toon.svg)

install(FILES packaging/dorbo.xml DESTINATION ${CMAKE_INSTALL_DATADIR}/mime/packages)
install(FILES packaging/org.dorbo.dorbo.metainfo.xml DESTINATION ${CMAKE_INSTALL_DATADIR}/metainfo)
install(FILES completions/toon.bash DESTINATION ${CMAKE_INSTALL_DATADIR}/bash-completion/completions
    RENAME toon)
install(FILES completions/toon.fish DESTINATION ${CMAKE_INSTALL_DATADIR}/fish/vendor_completions.d)

install(FILES packaging/copyright docs/security.md docs/starting.md docs/toon-format.md docs/trace.md
    docs/writing-toons.md DESTINATION ${DORBO_DOCS})
install(FILES docs/pictures/configuration.png docs/pictures/frame-editor.png
    docs/pictures/played.png docs/pictures/poses.png DESTINATION ${DORBO_DOCS}/pictures)

# What depends on the prefix, which may be chosen as late as when installing.
configure_file(packaging/at-install.cmake.in ${PROJECT_BINARY_DIR}/packaging/at-install.cmake @ONLY)
install(SCRIPT ${PROJECT_BINARY_DIR}/packaging/at-install.cmake)
