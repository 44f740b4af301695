# Makes a target from a folder. Warnings and language level are set per target, so that no
# flag affects the libraries that a target links.

add_library(pallax_options INTERFACE)
target_compile_features(pallax_options INTERFACE cxx_std_20)
target_compile_options(pallax_options INTERFACE
    -Wall -Wextra -Wpedantic -Wconversion -Wshadow -Werror
)
# Optimizing, g++ 12 takes `"text" + std::string` for a copy onto itself or of more bytes than there
# can be (its bug 105651). The sizes of other copies are looked at where less is optimized.
target_compile_options(pallax_options INTERFACE $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>
    "$<$<AND:$<CXX_COMPILER_ID:GNU>,$<CONFIG:Release>>:-Wno-array-bounds;-Wno-stringop-overflow>"
)
# With its own limits, g++ spends 7 % of the build collecting garbage; so it takes up to 0.9 GB.
target_compile_options(pallax_options INTERFACE "$<$<CXX_COMPILER_ID:GNU>:\
--param=ggc-min-expand=1000;--param=ggc-min-heapsize=500000>"
)
target_include_directories(pallax_options INTERFACE ${PROJECT_SOURCE_DIR})
# Releases read untrusted bytes: a fault that was missed should end the program.
target_compile_options(pallax_options INTERFACE
    "$<$<CONFIG:Release>:-fstack-protector-strong;-U_FORTIFY_SOURCE;-D_FORTIFY_SOURCE=2;-fPIE>"
)
target_link_options(pallax_options INTERFACE "$<$<CONFIG:Release>:-pie;-Wl,-z,relro,-z,now>")
if(PALLAX_SANITIZE)
    # -Wno-maybe-uninitialized: false positives of g++ 12 with the sanitizers' instrumentation.
    target_compile_options(pallax_options INTERFACE
        -fsanitize=${PALLAX_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer
        $<$<CXX_COMPILER_ID:GNU>:-Wno-maybe-uninitialized>
    )
    target_link_options(pallax_options INTERFACE -fsanitize=${PALLAX_SANITIZE})
endif()
# An index past the end of a standard container ends a test run, not only under sanitizers.
target_compile_definitions(pallax_options INTERFACE "$<$<CONFIG:Debug>:_GLIBCXX_ASSERTIONS>")
if(PALLAX_COVERAGE)
    # Counters only in measured code: those in library templates would double the build time. Every
    # process adds to one of four files of its executable.
    set(counters -fprofile-instr-generate=${PROJECT_BINARY_DIR}/profile/%4m.profraw)
    target_compile_options(pallax_options INTERFACE
        ${counters} -fcoverage-mapping
        -fprofile-list=${PROJECT_SOURCE_DIR}/cmake/coverage-sources
    )
    target_link_options(pallax_options INTERFACE ${counters})
endif()

# For sources that use the version and its date.
add_library(pallax_version INTERFACE)
target_compile_definitions(pallax_version INTERFACE
    PALLAX_VERSION="${PROJECT_VERSION}"
    PALLAX_DATE="${PALLAX_DATE}"
)

function(pallax_instrument_for_fuzzing target)
    if(PALLAX_BUILD_FUZZERS)
        target_compile_options(${target} PRIVATE -fsanitize=fuzzer-no-link)
    endif()
endfunction()

# What is tested runs three times as fast when it is optimized a little, and takes no longer to
# compile; the tests around it would only take longer to build.
set(pallax_packet_level $<$<CONFIG:Debug>:-O1>)
# -O3 takes g++ a quarter longer than -O2, and a program that decodes, half as long again without it.
set(pallax_command_level $<IF:$<CONFIG:Debug>,-O1,-O2>) # of what does not handle each packet
set(pallax_library_level ${pallax_packet_level})

# pallax_precompile(NAME header...): the headers whose parsing takes most of the time of compiling a
# source. The preset "core" builds without them: a source of the core with a missing include fails
# there.
function(pallax_precompile name)
    if(NOT PALLAX_PRECOMPILE)
        return()
    endif()
    file(WRITE ${PROJECT_BINARY_DIR}/precompiled.cpp "")
    add_library(${name} STATIC ${PROJECT_BINARY_DIR}/precompiled.cpp)
    target_link_libraries(${name} PUBLIC pallax_options)
    target_precompile_headers(${name} PRIVATE
        <algorithm> <array> <chrono> <cmath> <cstdint> <functional> <map> <memory>
        <optional> <span> <stdexcept> <string> <string_view> <variant> <vector> ${ARGN}
    )
    pallax_instrument_for_fuzzing(${name})
    target_compile_options(${name} PRIVATE ${pallax_library_level})
endfunction()
pallax_precompile(pallax_precompiled)
set(pallax_precompiled pallax_precompiled) # for the libraries of a folder and those below

# pallax_library(NAME SOURCES file... [LINKS library...])
# One static library for a folder, linking only the folders below it.
function(pallax_library name)
    cmake_parse_arguments(ARG "" "" "SOURCES;LINKS" ${ARGN})
    add_library(${name} STATIC ${ARG_SOURCES})
    target_link_libraries(${name} PUBLIC pallax_options ${ARG_LINKS})
    pallax_instrument_for_fuzzing(${name})
    target_compile_options(${name} PRIVATE ${pallax_library_level})
    if(PALLAX_PRECOMPILE)
        target_precompile_headers(${name} REUSE_FROM ${pallax_precompiled})
    endif()
endfunction()

# pallax_bundle(NAME library...): one static archive made of several.
function(pallax_bundle name)
    set(objects "")
    foreach(library IN LISTS ARGN)
        list(APPEND objects $<TARGET_OBJECTS:${library}>)
    endforeach()
    add_library(${name} STATIC ${objects})
    set_target_properties(${name} PROPERTIES LINKER_LANGUAGE CXX)
    target_link_libraries(${name} PUBLIC pallax_options pugixml::pugixml)
endfunction()
