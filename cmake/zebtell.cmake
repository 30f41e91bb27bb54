# What every target of the project has in common.

add_compile_options(-Wall -Wextra -Wpedantic -Werror)
if(CMAKE_CXX_COMPILER_ID STREQUAL GNU)
    # GCC 12 sees overlapping, endless and overlong copies in inlined std::string code where there
    # are none.
    add_compile_options(-Wno-array-bounds -Wno-restrict -Wno-stringop-overflow)
endif()
set(CMAKE_CXX_FLAGS_RELEASE "-O2 -DNDEBUG")
if(ZEBTELL_SANITIZE)
    add_compile_options(-fsanitize=${ZEBTELL_SANITIZE} -fno-omit-frame-pointer
                        -fno-sanitize-recover=all)
    if(CMAKE_CXX_COMPILER_ID STREQUAL GNU)
        # GCC 12 takes parts of std::regex for uninitialized when it is watched.
        add_compile_options(-Wno-maybe-uninitialized)
    endif()
    add_link_options(-fsanitize=${ZEBTELL_SANITIZE})
endif()

if(ZEBTELL_FUZZ)
    add_compile_options(-fsanitize=fuzzer-no-link)
endif()

if(ZEBTELL_SANITIZE STREQUAL thread)
    # ThreadSanitizer does not follow memory fences: Asio has one that can be left out, and one in
    # its reference counts, where the counter's own order is enough for the sanitizer.
    add_compile_definitions(BOOST_ASIO_DISABLE_FENCED_BLOCK)
    add_compile_options(-Wno-tsan)
endif()

find_package(Threads REQUIRED)
find_package(PkgConfig REQUIRED)

# The standard headers that nearly every file reads, compiled once.
add_library(zebtell_std OBJECT ${CMAKE_CURRENT_LIST_DIR}/std.cpp)
target_precompile_headers(zebtell_std PRIVATE ${CMAKE_CURRENT_LIST_DIR}/std.h)

# zebtell_library(folder DEPENDS layer... LINK target...) makes the layer src/<folder> of all its
# files but EXCEPT, sub-folders included. DEPENDS names the layers that it may include.
function(zebtell_library name)
    cmake_parse_arguments(ARG "" "EXCEPT" "DEPENDS;LINK" ${ARGN})
    file(GLOB_RECURSE sources CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/src/${name}/*.cpp)
    if(ARG_EXCEPT)
        list(REMOVE_ITEM sources ${PROJECT_SOURCE_DIR}/src/${name}/${ARG_EXCEPT})
    endif()
    list(TRANSFORM ARG_DEPENDS PREPEND zebtell_)
    if(sources)
        add_library(zebtell_${name} STATIC ${sources})
        target_include_directories(zebtell_${name} PUBLIC ${PROJECT_SOURCE_DIR}/src)
        target_link_libraries(zebtell_${name} PUBLIC ${ARG_DEPENDS} ${ARG_LINK} Threads::Threads)
        target_precompile_headers(zebtell_${name} REUSE_FROM zebtell_std)
    else()
        add_library(zebtell_${name} INTERFACE)
        target_include_directories(zebtell_${name} INTERFACE ${PROJECT_SOURCE_DIR}/src)
        target_link_libraries(zebtell_${name} INTERFACE ${ARG_DEPENDS} ${ARG_LINK} Threads::Threads)
    endif()
endfunction()

# zebtell_test(folder LINK layer...) makes one test program of tests/<folder>/*.cpp.
function(zebtell_test name)
    cmake_parse_arguments(ARG "" "" "LINK" ${ARGN})
    file(GLOB sources CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/tests/${name}/*.cpp)
    if(NOT sources)
        return()
    endif()
    list(TRANSFORM ARG_LINK PREPEND zebtell_)
    add_executable(${name}_tests ${sources})
    target_include_directories(${name}_tests PRIVATE ${PROJECT_SOURCE_DIR})
    target_link_libraries(${name}_tests PRIVATE ${ARG_LINK} zebtell_test_main)
    target_precompile_headers(${name}_tests REUSE_FROM zebtell_test_main)
    add_test(NAME ${name} COMMAND ${name}_tests)
endfunction()

# zebtell_fuzz(name LINK layer... USES file...) makes the fuzz target tests/fuzz/<name>.cpp. USES
# names files of other tests that it is built with.
function(zebtell_fuzz name)
    cmake_parse_arguments(ARG "" "" "LINK;USES" ${ARGN})
    list(TRANSFORM ARG_LINK PREPEND zebtell_)
    list(TRANSFORM ARG_USES PREPEND ${PROJECT_SOURCE_DIR}/tests/)
    add_executable(fuzz_${name} ${name}.cpp harness.cpp ${ARG_USES})
    target_include_directories(fuzz_${name} PRIVATE ${PROJECT_SOURCE_DIR})
    target_compile_definitions(fuzz_${name}
                               PRIVATE ZEBTELL_SOURCE_FOLDER="${PROJECT_SOURCE_DIR}"
                                       ZEBTELL_DEFAULT_TEMPLATES="${ZEBTELL_TEMPLATES}")
    target_link_libraries(fuzz_${name} PRIVATE ${ARG_LINK})
    target_link_options(fuzz_${name} PRIVATE -fsanitize=fuzzer)
    add_dependencies(fuzz fuzz_${name})
endfunction()
