# cpack -G DEB makes the Debian package of what is installed.

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME pelorus)
set(CPACK_PACKAGE_CONTACT "The Pelorus authors <pelorus@localhost>")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY ${PROJECT_DESCRIPTION})
set(CPACK_PACKAGE_DESCRIPTION "Shows what a handset's baseband reports on its diagnostic log channel, in a window and
in a terminal, and decodes recordings of it. Comes with a telephony server that plays a handset.")
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION net)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
# Plug-ins of the toolkit, which no program links to.
set(CPACK_DEBIAN_PACKAGE_RECOMMENDS "qt6-wayland")
set(CPACK_DEBIAN_PACKAGE_SUGGESTS "modemmanager")
include(CPack)
