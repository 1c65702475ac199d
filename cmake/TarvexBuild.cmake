# Compiler settings shared by every target of this build.
set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY "${PROJECT_BINARY_DIR}/bin")
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY "${PROJECT_BINARY_DIR}/lib")
# A translated resource library is looked up beside its module, so programs and libraries keep their real paths. What is
# built has the search path that it is installed with: the build's own one would be padded to that one's length with empty
# entries, and the loader takes an empty entry for the current folder.
set(CMAKE_BUILD_WITH_INSTALL_RPATH ON)
set(CMAKE_INSTALL_RPATH "$ORIGIN;$ORIGIN/../lib")
set(CMAKE_INSTALL_RPATH_USE_LINK_PATH ON)

find_program(TVX_CCACHE ccache)
if(TVX_CCACHE AND NOT CMAKE_CXX_COMPILER_LAUNCHER)
  set(launcher "${CMAKE_CURRENT_LIST_DIR}/compile-cached" "${TVX_CCACHE}")
  set(CMAKE_C_COMPILER_LAUNCHER ${launcher})
  set(CMAKE_CXX_COMPILER_LAUNCHER ${launcher})
endif()
if(CMAKE_CXX_COMPILER_ID STREQUAL Clang)
  add_compile_options("SHELL:-Xclang -fno-pch-timestamp")
endif()

# Bitwise use of unsigned style constants and message parameters is everyday work here, so -Wconversion stays off.
add_compile_options(-Wall -Wextra -Wpedantic -Wnon-virtual-dtor -Wno-unused-parameter)
# g++ 12 suspects its own string header of writing out of bounds (its bug 105651), and where that comes out of a
# precompiled header it no longer counts as the system's. AddressSanitizer finds what these warnings would.
if(CMAKE_CXX_COMPILER_ID STREQUAL GNU)
  add_compile_options(-Wno-array-bounds -Wno-stringop-overflow -Wno-stringop-overread -Wno-restrict)
endif()
if(TVX_WARNINGS_AS_ERRORS)
  add_compile_options(-Werror)
endif()
if(TVX_SANITIZE)
  # No vptr: hosts cast the window that GetDlgItem answers to the class of the control, which a temporary is not.
  add_compile_options(
    -fsanitize=${TVX_SANITIZE} -fno-sanitize=vptr -fno-omit-frame-pointer -fno-sanitize-recover=all)
  add_link_options(-fsanitize=${TVX_SANITIZE})
endif()
if(TVX_COVERAGE)
  add_compile_options(--coverage)
  add_link_options(--coverage)
endif()
# What the fuzzing engine watches; the engine itself is linked by the fuzz targets only. This is what its own option
# (fuzzer-no-link) instruments, less the depth of the stack: that depends on the size of the environment, and with it
# which inputs the engine makes next.
if(TVX_FUZZ)
  add_compile_options(-fsanitize-coverage=inline-8bit-counters,indirect-calls,trace-cmp,pc-table)
endif()
