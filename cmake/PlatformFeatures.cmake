# What a platform may lack. Each feature is looked for. Where it is found, the sources in System/ and Write/ use it; the
# program works without it.

include(CheckCXXSymbolExists)
include(CheckLinkerFlag)
include(CheckStructHasMember)

function(pagemeld_feature name is_found)
    if(is_found AND NOT PAGEMELD_PORTABLE)
        target_compile_definitions(pagemeld_settings INTERFACE PAGEMELD_HAVE_${name})
    endif()
endfunction()

# File systems that share blocks: copies of one JSON text take no space.
check_cxx_symbol_exists(FICLONE linux/fs.h has_ficlone)
pagemeld_feature(FILE_CLONES "${has_ficlone}")

# A heap that can be told how to grow, in huge pages.
check_cxx_symbol_exists(M_TOP_PAD malloc.h has_top_pad)
check_cxx_symbol_exists(MADV_HUGEPAGE sys/mman.h has_huge_pages)
if(has_top_pad AND has_huge_pages)
    pagemeld_feature(HEAP_ADVICE ON)
endif()

# Listings that tell the type of an entry.
check_struct_has_member("struct dirent" d_type dirent.h has_dirent_type LANGUAGE CXX)
pagemeld_feature(DIRENT_TYPE "${has_dirent_type}")

# Relocations that are resolved at start and read-only from then on.
check_linker_flag(CXX -Wl,-z,relro,-z,now has_relro)
if(has_relro AND NOT PAGEMELD_PORTABLE)
    target_link_options(pagemeld_settings INTERFACE $<$<CONFIG:Release>:-Wl,-z,relro,-z,now>)
endif()
