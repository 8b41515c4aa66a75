# The Debian package, made by `./run package`.
set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME velmora)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_CONTACT "The developers of libKVpyextUi <velmora@quorvane.invalid>")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "compositing application with user interface for Python scripts")
set(CPACK_PACKAGE_DESCRIPTION
    "Velmora opens compositions and runs Python scripts in them. With the Python
package quorvane_velmora, scripts show forms and dialogs, inside the
application and outside.")
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION graphics)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${PROJECT_BINARY_DIR}/${KV_LIBRARY_PLACE}
    ${KV_PACKAGE_DIR}/quorvane_velmora/libs)
# The modules are for one version of the interpreter.
math(EXPR next "${Python3_VERSION_MINOR} + 1")
set(CPACK_DEBIAN_PACKAGE_DEPENDS "python3 (>= 3.${Python3_VERSION_MINOR}), python3 (<< 3.${next})")
set(CPACK_DEBIAN_PACKAGE_RECOMMENDS "qt6-wayland, fonts-dejavu-core")
set(CPACK_DEBIAN_PACKAGE_SUGGESTS "fonts-noto-color-emoji, python3-pytest")
set(CPACK_DEBIAN_PACKAGE_CONTROL_EXTRA ${PROJECT_SOURCE_DIR}/resources/debian/prerm)
include(CPack)
