#[=======================================================================[
pagemeld_combine
----------------

Adds a target that combines documentation modules::

    pagemeld_combine(<target>
        (ROOTS <dir>... | DISCOVER <dir>)
        [ALL] [NO_CHECK | WERROR] [WEB]
        [DEPENDS <file|target>...]
        [COMMENT <text>])

It comes with ``find_package(Pagemeld)``, or with this project by ``add_subdirectory`` or ``FetchContent``. All of these
also define the targets ``Pagemeld::pagemeld`` and ``Pagemeld::pagemeld-check``. Ninja and Makefiles are supported.

``ROOTS``
  The module roots, in the order in which they are merged. Relative ones start at the current source directory. The
  programs get absolute paths without a slash at the end, as links between modules need them.
``DISCOVER``
  A directory below which the modules are found when the target is built: ``pagemeld -autopaths``.
``ALL``
  Makes the target part of the default build.
``NO_CHECK``
  Leaves out ``pagemeld-check``, which otherwise runs first and stops the build at its errors.
``WERROR``
  Stops the build at the checker's warnings as well.
``WEB``
  Copies the files of the page script into each ``docdata`` before combining.
``DEPENDS``
  What makes the modules: files, or targets that are defined before this call. Modules that the build itself makes must
  be named here. Files are the better choice, because a custom target with a command counts as changed each time.
``COMMENT``
  The line that the build shows.

With ``ROOTS`` or ``DEPENDS`` the target does its work only if something changed: the ``index.json`` or ``toc.json`` of
a module, what ``DEPENDS`` names, the arguments, the programs, or the page script. With Ninja also if an output of
``ROOTS`` was removed, of those documentation sets whose ``index.json`` was there, or named in ``DEPENDS``, when
CMake last ran. With ``DISCOVER`` a new module is noticed only by what ``DEPENDS`` names.

``DISCOVER`` without ``DEPENDS`` runs in every build, since CMake knows no file that could have changed.

The build names each documentation set that no module has: warnings about its ``index.json`` are harmless.

Two targets over the same modules must be chained, the second with ``DEPENDS <first>``: they write the same files.
#]=======================================================================]

cmake_policy(PUSH)
cmake_policy(VERSION 3.25)

# The functions below that begin with an underscore use the arguments of pagemeld_combine, arg_*, and its variables.

function(_pagemeld_check_arguments)
    if(arg_UNPARSED_ARGUMENTS)
        message(FATAL_ERROR "pagemeld_combine(${target}): unknown arguments: ${arg_UNPARSED_ARGUMENTS}")
    elseif(DEFINED arg_ROOTS AND DEFINED arg_DISCOVER OR NOT DEFINED arg_ROOTS AND NOT DEFINED arg_DISCOVER)
        message(FATAL_ERROR "pagemeld_combine(${target}): needs either ROOTS or DISCOVER, with a value")
    elseif(arg_NO_CHECK AND arg_WERROR)
        message(FATAL_ERROR "pagemeld_combine(${target}): takes only one of NO_CHECK and WERROR")
    endif()
endfunction()

# Writes what the script of the modules reads. It changes with every argument that changes a command: Makefiles don't
# look at commands.
function(_pagemeld_write_arguments)
    file(GENERATE OUTPUT "${directory}/arguments.cmake" CONTENT "# ${programs} ${check_options}
set(roots [==[${roots}]==])
set(discover [==[${discover}]==])
set(web_files [==[${web_files}]==])
set(stamp [==[${directory}/stamp]==])
set(dependency_file [==[${directory}/inputs.d]==])
")
endfunction()

# Sets outputs to the files that will be written into the roots, as far as can be told before the build: those of each
# set that has an input.
function(_pagemeld_list_outputs)
    list(TRANSFORM web_files REPLACE ".*/" "" OUTPUT_VARIABLE web_names)
    set(names global_index.json global_index.js global_toc.json global_toc.js ${web_names})
    set(outputs)
    foreach(set IN ITEMS Manual ScriptReference)
        foreach(root IN LISTS roots)
            # Ninja makes the directories of outputs before the check runs: none may appear in a misspelled root.
            set(input "${root}/${set}/docdata/index.json")
            if(EXISTS "${input}" OR input IN_LIST arg_DEPENDS)
                list(TRANSFORM names PREPEND "${root}/${set}/docdata/" OUTPUT_VARIABLE of_module)
                list(APPEND outputs ${of_module})
            endif()
        endforeach()
    endforeach()

    # Ninja takes only one rule for a file. The target that is chained to it runs after that rule.
    get_property(taken GLOBAL PROPERTY PAGEMELD_OUTPUTS)
    list(REMOVE_ITEM outputs ${taken})
    list(REMOVE_DUPLICATES outputs)
    set_property(GLOBAL APPEND PROPERTY PAGEMELD_OUTPUTS ${outputs})
    set(outputs ${outputs} PARENT_SCOPE)
endfunction()

# Sets target_files to the files by which a build notices that a target in DEPENDS did something: CMake itself only
# makes sure that it is built first.
function(_pagemeld_list_target_files)
    set(target_files)
    foreach(dependency IN LISTS arg_DEPENDS)
        if(NOT TARGET "${dependency}")
            continue()
        endif()
        get_target_property(stamp ${dependency} PAGEMELD_STAMP)
        get_target_property(type ${dependency} TYPE)
        if(stamp)
            list(APPEND target_files "${stamp}")
        elseif(type STREQUAL "UTILITY" AND CMAKE_GENERATOR MATCHES "Ninja")
            # Ninja looks at all files before it starts, so it would notice what the target writes one build late.
            list(APPEND target_files
                "$<FILTER:$<TARGET_PROPERTY:${dependency},SOURCES>,INCLUDE,/CMakeFiles/${dependency}$>")
        endif()
    endforeach()
    set(target_files ${target_files} PARENT_SCOPE)
endfunction()

function(pagemeld_combine target)
    cmake_parse_arguments(PARSE_ARGV 1 arg "ALL;NO_CHECK;WERROR;WEB" "DISCOVER;COMMENT" "ROOTS;DEPENDS")
    _pagemeld_check_arguments()

    set(roots)
    foreach(root IN LISTS arg_ROOTS arg_DISCOVER)
        cmake_path(ABSOLUTE_PATH root NORMALIZE)
        string(REGEX REPLACE "/$" "" root "${root}")
        list(APPEND roots "${root}")
    endforeach()
    set(check_roots ${roots})
    set(combine_roots ${roots})
    set(discover)
    if(DEFINED arg_DISCOVER)
        set(check_roots "--discover=${roots}")
        set(combine_roots -autopaths "${roots}")
        set(discover "${roots}")
        set(roots)
    endif()

    set(directory "${CMAKE_CURRENT_BINARY_DIR}/${target}.pagemeld")
    set(script "${CMAKE_CURRENT_FUNCTION_LIST_DIR}/PagemeldModules.cmake")
    set(programs Pagemeld::pagemeld)
    set(check_options)
    set(commands)
    if(NOT arg_NO_CHECK)
        list(APPEND programs Pagemeld::pagemeld-check)
        if(arg_WERROR)
            set(check_options --werror)
        endif()
        set(commands COMMAND Pagemeld::pagemeld-check ${check_options} ${check_roots})
    endif()
    list(APPEND commands COMMAND ${CMAKE_COMMAND} -D "arguments=${directory}/arguments.cmake" -P "${script}")
    list(APPEND commands COMMAND Pagemeld::pagemeld ${combine_roots})
    list(APPEND commands COMMAND ${CMAKE_COMMAND} -E touch "${directory}/stamp")

    set(web_files)
    if(arg_WEB)
        get_target_property(web Pagemeld::pagemeld PAGEMELD_WEB_DIRECTORY)
        string(REGEX REPLACE "([[*?])" "[\\1]" pattern "${web}")
        file(GLOB web_files "${pattern}/*")
    endif()
    _pagemeld_write_arguments()

    set(all)
    if(arg_ALL)
        set(all ALL)
    endif()
    if(NOT DEFINED arg_COMMENT)
        set(arg_COMMENT "Combining documentation modules: ${target}")
    endif()
    if(DEFINED arg_DISCOVER AND NOT arg_DEPENDS)
        add_custom_target(
            ${target} ${all} ${commands} BYPRODUCTS "${directory}/stamp" COMMENT "${arg_COMMENT}" VERBATIM)
    else()
        _pagemeld_list_outputs()
        _pagemeld_list_target_files()
        add_custom_command(
            OUTPUT "${directory}/stamp"
            BYPRODUCTS ${outputs} ${commands}
            DEPENDS ${programs} "${directory}/arguments.cmake" "${script}" ${web_files} ${arg_DEPENDS} ${target_files}
            DEPFILE "${directory}/inputs.d"
            COMMENT "${arg_COMMENT}"
            VERBATIM)
        add_custom_target(${target} ${all} DEPENDS "${directory}/stamp")
    endif()
    set_target_properties(${target} PROPERTIES PAGEMELD_STAMP "${directory}/stamp")
endfunction()

cmake_policy(POP)
