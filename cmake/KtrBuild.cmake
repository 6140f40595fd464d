# Language, warnings and sanitizers shared by every target of the project.
set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/lib)
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)

if(NOT CMAKE_BUILD_TYPE)
    set(CMAKE_BUILD_TYPE Release)
endif()

find_program(KTR_CCACHE ccache)
if(KTR_CCACHE)
    # It looks at what a precompiled header was made of, not at its age.
    set(CMAKE_CXX_COMPILER_LAUNCHER env CCACHE_SLOPPINESS=pch_defines,time_macros,include_file_mtime,include_file_ctime
        ${KTR_CCACHE})
endif()

add_library(ktr_warnings INTERFACE)
target_compile_options(ktr_warnings INTERFACE -Wall -Wextra -Wpedantic -Wconversion -Wshadow -Werror)
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    # GCC 12 warns, when it optimises, of overlapping copies in "text" + std::string and of empty std::optionals being read
    # where there are none (GCC bugs 105651 and 80635).
    target_compile_options(ktr_warnings INTERFACE -Wno-restrict -Wno-maybe-uninitialized)
else()
    # Clang counts signs among the conversions, GCC does not.
    target_compile_options(ktr_warnings INTERFACE -Wno-sign-conversion)
endif()

if(KTR_SANITIZE)
    list(JOIN KTR_SANITIZE "," ktr_sanitizers)
    add_compile_options(-fsanitize=${ktr_sanitizers} -fno-sanitize-recover=all -fno-omit-frame-pointer)
    add_link_options(-fsanitize=${ktr_sanitizers})
    if("thread" IN_LIST KTR_SANITIZE)
        # The sanitizer does not understand fences; asio's are beside locks, which it does.
        add_compile_definitions(BOOST_ASIO_DISABLE_FENCED_BLOCK)
        if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
            # GCC 12 does not see under this sanitizer that "std::string(400, '9') + text" has grown.
            target_compile_options(ktr_warnings INTERFACE -Wno-array-bounds -Wno-stringop-overflow -Wno-stringop-overread)
        endif()
    endif()
endif()

# ktr_sources(<out> <folder>...): the .cpp files directly in these folders, sorted.
function(ktr_sources out)
    set(found "")
    foreach(folder IN LISTS ARGN)
        file(GLOB here CONFIGURE_DEPENDS ${folder}/*.cpp)
        list(APPEND found ${here})
    endforeach()
    list(SORT found)
    set(${out} ${found} PARENT_SCOPE)
endfunction()
