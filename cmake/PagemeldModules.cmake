# The part of pagemeld_combine that must wait until the modules are made: copies the page script into them, and lists
# their input files for the build, in a dependency file.
#
#     cmake -D arguments=FILE -P PagemeldModules.cmake

cmake_minimum_required(VERSION 3.25)
include("${arguments}")

# Sets modules to the module roots below a directory, by the rules of pagemeld -autopaths.
function(find_modules directory)
    set(found)
    string(REGEX REPLACE "([[*?])" "[\\1]" pattern "${directory}")
    file(GLOB names LIST_DIRECTORIES true RELATIVE "${directory}" "${pattern}/*")
    foreach(name IN LISTS names)
        set(path "${directory}/${name}")
        if(name MATCHES "^[.]" OR IS_SYMLINK "${path}" OR NOT IS_DIRECTORY "${path}")
            continue()
        elseif(IS_DIRECTORY "${path}/Manual/docdata")
            list(APPEND found "${path}")
        else()
            find_modules("${path}")
            list(APPEND found ${modules})
        endif()
    endforeach()
    set(modules ${found} PARENT_SCOPE)
endfunction()

set(modules ${roots})
if(NOT discover STREQUAL "")
    find_modules("${discover}")
endif()

set(dependencies "${stamp}:")
foreach(module IN LISTS modules)
    foreach(set IN ITEMS Manual ScriptReference)
        set(docdata "${module}/${set}/docdata")
        if(web_files AND IS_DIRECTORY "${docdata}")
            file(COPY ${web_files} DESTINATION "${docdata}")
        endif()
        foreach(input IN ITEMS "${docdata}/index.json" "${docdata}/toc.json")
            if(EXISTS "${input}")
                string(APPEND dependencies "\n${input}")
            endif()
        endforeach()
    endforeach()
endforeach()

# The form that compilers write: escaped spaces, and a backslash at the end of each line but the last.
string(REPLACE "$" "$$" dependencies "${dependencies}")
string(REPLACE " " "\\ " dependencies "${dependencies}")
string(REPLACE "\n" " \\\n  " dependencies "${dependencies}")
file(WRITE "${dependency_file}" "${dependencies}\n")
