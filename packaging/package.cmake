# The Debian package, by `cmake --build --preset release --target package`.
set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME dorbo)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_CONTACT "The Dorbo developers <dorbo@dorbo.invalid>")
set(CPACK_STRIP_FILES ON)
# What is installed names the prefix that it will have, not the one of the packing.
set(CPACK_SET_DESTDIR ON)
set(CPACK_INSTALL_PREFIX /usr)

set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION x11)
set(CPACK_DEBIAN_PACKAGE_PRIORITY optional)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_DEPENDS fonts-liberation) # the faces of titles, bubbles and dialogs
set(CPACK_DEBIAN_PACKAGE_SUGGESTS "xscreensaver | xsecurelock | xautolock | xss-lock") # call it
set(CPACK_DEBIAN_PACKAGE_DESCRIPTION
    "screen saver with a small fellow who walks about
Dorbo comes in from the nearer side of the screen, strikes a pose, blinks,
says something in a bubble and goes off again. He acts out Toons, little
plays that anybody can write, or wanders over tiled backgrounds and says wise
things.
.
The package holds the saver and its setup, an editor for Toons, a program for
the command line that plays, checks and films them, and eight Toons.")
include(CPack)
