#[=======================================================================[
pagemeld_docdata
----------------

Makes the inputs of documentation sets from their HTML pages during the build::

    pagemeld_docdata(<output-variable>
        SETS <dir>...
        [PAGE_SCRIPT] [TOC <page>...] [OPTIONS <option>...]
        DEPENDS <file|target>...)

It comes with ``pagemeld_combine``, and defines the target ``Pagemeld::pagemeld-docdata`` for commands of your own.

``<output-variable>``
  Is set to the files that are made, for ``DEPENDS`` of ``pagemeld_combine``.
``SETS``
  The set directories, such as ``core/Manual``. Relative ones start at the current source directory.
``PAGE_SCRIPT``
  Puts the page script into every page and into ``docdata``.
``TOC``
  The pages whose lists are the contents, instead of those that the generator of the pages usually has.
``OPTIONS``
  Other options of ``pagemeld-docdata``.
``DEPENDS``
  What makes the pages: files, or targets that are built first. Only files make the inputs anew when they change.
#]=======================================================================]

function(pagemeld_docdata output)
    cmake_parse_arguments(PARSE_ARGV 1 arg "PAGE_SCRIPT" "" "SETS;TOC;OPTIONS;DEPENDS")
    if(arg_UNPARSED_ARGUMENTS)
        message(FATAL_ERROR "pagemeld_docdata(${output}): unknown arguments: ${arg_UNPARSED_ARGUMENTS}")
    elseif(NOT arg_SETS OR NOT arg_DEPENDS)
        message(FATAL_ERROR "pagemeld_docdata(${output}): needs SETS and DEPENDS, with values")
    endif()

    set(options ${arg_OPTIONS})
    if(arg_PAGE_SCRIPT)
        list(APPEND options --page-script)
    endif()
    foreach(page IN LISTS arg_TOC)
        list(APPEND options --toc ${page})
    endforeach()

    get_target_property(program Pagemeld::pagemeld-docdata IMPORTED_LOCATION)
    set(files)
    foreach(set IN LISTS arg_SETS)
        cmake_path(ABSOLUTE_PATH set NORMALIZE)
        string(REGEX REPLACE "/$" "" set "${set}")
        set(inputs "${set}/docdata/index.json" "${set}/docdata/toc.json")
        add_custom_command(
            OUTPUT ${inputs}
            COMMAND "${program}" ${options} "${set}"
            DEPENDS "${program}" ${arg_DEPENDS}
            COMMENT "Making the inputs of ${set}"
            VERBATIM)
        list(APPEND files ${inputs})
    endforeach()
    set(${output} ${files} PARENT_SCOPE)
endfunction()
