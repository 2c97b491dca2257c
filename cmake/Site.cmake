# Our documentation as combined HTML, made by the programs themselves. It is installed instead of the Markdown files.

set(PAGEMELD_SITE AUTO CACHE STRING "Make the documentation as HTML: ON, OFF, or AUTO if its tools are found")
set_property(CACHE PAGEMELD_SITE PROPERTY STRINGS AUTO ON OFF)

set(makes_site ${PAGEMELD_SITE})
if(PAGEMELD_SITE)
    foreach(tool cmark-gfm doxygen mandoc python3)
        find_program(PROGRAM_${tool} ${tool})
        if(NOT PROGRAM_${tool} AND PAGEMELD_SITE STREQUAL "AUTO")
            message(STATUS "The documentation is not made as HTML: that needs ${tool}")
            set(makes_site OFF)
        elseif(NOT PROGRAM_${tool})
            message(FATAL_ERROR "The documentation as HTML needs ${tool}")
        endif()
    endforeach()
endif()

# The README that is installed begins where the sources are no longer needed.
file(READ README.md readme)
string(REGEX REPLACE "## Try it.*\n## Install" "## Install" readme "${readme}")
if(readme MATCHES "script/|cmake ")
    message(FATAL_ERROR "The README to install names what only the sources have")
endif()
file(WRITE ${PROJECT_BINARY_DIR}/README.md "${readme}")

if(NOT makes_site)
    install(FILES ${PROJECT_BINARY_DIR}/README.md CHANGELOG.md CONTRIBUTING.md SECURITY.md DESTINATION ${CMAKE_INSTALL_DOCDIR})
    install(DIRECTORY docs DESTINATION ${CMAKE_INSTALL_DOCDIR} PATTERN site.css EXCLUDE)
    return()
endif()

set(site ${PROJECT_BINARY_DIR}/site)
file(GLOB site_sources CONFIGURE_DEPENDS
     *.md Tools/DocTools/PagemeldDocdata/* docs/* man/* packaging/Doxyfile script/site* web/*)
file(GLOB_RECURSE headers CONFIGURE_DEPENDS Modules/*.h Runtime/*.h Tools/*.h)
add_custom_command(
    OUTPUT site.stamp
    COMMAND ${PROJECT_SOURCE_DIR}/script/site ${PROJECT_BINARY_DIR} ${site}
    COMMAND ${CMAKE_COMMAND} -E touch ${PROJECT_BINARY_DIR}/site.stamp
    DEPENDS pagemeld pagemeld-check ${site_sources} ${headers}
    COMMENT "Making the documentation"
    VERBATIM)
add_custom_target(site ALL DEPENDS site.stamp)
install(DIRECTORY ${site}/ DESTINATION ${CMAKE_INSTALL_DOCDIR}/html)
