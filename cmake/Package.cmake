# A Debian package of what is installed: cpack -G DEB. script/package makes and tries the one that is released.

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME pagemeld)
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "combines the search and contents of documentation modules")
set(CPACK_PACKAGE_DESCRIPTION
    "Pagemeld joins manuals that are built separately, by Doxygen, Sphinx, javadoc
or anything else that makes HTML. It merges their search indexes and tables of
contents: readers search and browse all of them from any page, on a web server
or from a directory on disk.

A checker reports beforehand what would go wrong and where. A CMake function
runs both in a build.")
set(CPACK_STRIP_FILES ON)
set(CPACK_PRE_BUILD_SCRIPTS ${PROJECT_SOURCE_DIR}/packaging/prepare.cmake)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_DEPENDS python3) # pagemeld-docdata
set(CPACK_DEBIAN_PACKAGE_SECTION devel)
set(CPACK_DEBIAN_PACKAGE_MAINTAINER "Pagemeld maintainers <maintainers@pagemeld.example>")
include(CPack)
