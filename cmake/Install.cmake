# What cmake --install puts where: the programs, the CMake package, the page script, and the documents.

include(CMakePackageConfigHelpers)
set(CMAKE_INSTALL_DOCDIR share/doc/pagemeld CACHE PATH "Directory of README, docs and the examples")
include(GNUInstallDirs)

install(TARGETS pagemeld pagemeld-check EXPORT PagemeldTargets)

# CMake looks in lib for every platform, also for projects without a language.
set(package_directory lib/cmake/Pagemeld)
set(PAGEMELD_WEB_DIRECTORY ${CMAKE_INSTALL_DATADIR}/pagemeld/web)
configure_package_config_file(
    cmake/PagemeldConfig.cmake.in ${PROJECT_BINARY_DIR}/PagemeldConfig.cmake
    INSTALL_DESTINATION ${package_directory}
    PATH_VARS CMAKE_INSTALL_BINDIR PAGEMELD_WEB_DIRECTORY)
write_basic_package_version_file(
    ${PROJECT_BINARY_DIR}/PagemeldConfigVersion.cmake
    COMPATIBILITY SameMajorVersion ARCH_INDEPENDENT)
install(EXPORT PagemeldTargets NAMESPACE Pagemeld:: DESTINATION ${package_directory})
install(FILES ${PROJECT_BINARY_DIR}/PagemeldConfig.cmake ${PROJECT_BINARY_DIR}/PagemeldConfigVersion.cmake
              cmake/PagemeldCombine.cmake cmake/PagemeldDocdata.cmake cmake/PagemeldModules.cmake
        DESTINATION ${package_directory})

install(DIRECTORY web/ DESTINATION ${PAGEMELD_WEB_DIRECTORY})
install(FILES LICENSE DESTINATION ${CMAKE_INSTALL_DOCDIR})
install(DIRECTORY examples DESTINATION ${CMAKE_INSTALL_DOCDIR} PATTERN __pycache__ EXCLUDE)

# The program looks for its modules, and for web, below the share beside its bin.
set(docdata_sources Tools/DocTools/PagemeldDocdata)
install(PROGRAMS ${docdata_sources}/pagemeld-docdata TYPE BIN)
install(DIRECTORY ${docdata_sources}/ DESTINATION ${CMAKE_INSTALL_DATADIR}/pagemeld/docdata FILES_MATCHING PATTERN *.py)
file(WRITE ${PROJECT_BINARY_DIR}/docdata/version "${PROJECT_VERSION}\n")
install(FILES ${PROJECT_BINARY_DIR}/docdata/version DESTINATION ${CMAKE_INSTALL_DATADIR}/pagemeld/docdata)

install(DIRECTORY schema DESTINATION ${CMAKE_INSTALL_DATADIR}/pagemeld)
add_subdirectory(man)
include(cmake/Site.cmake)
