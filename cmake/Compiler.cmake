# Warnings for our own code, ccache where it is installed, and one precompiled Qt Core header for the engine.

find_program(TUNESTEAD_CCACHE ccache)
if(TUNESTEAD_CCACHE)
  # Without these ccache refuses every source that uses a precompiled header. The compiler crashes when it is to
  # preprocess one alone, so the cache goes by the headers that a compilation names and not by its preprocessed text.
  # It must look at their times: one that was changed during a compilation would be stored with what it was before.
  set(CMAKE_CXX_COMPILER_LAUNCHER ${CMAKE_COMMAND} -E env CCACHE_DEPEND=1
    CCACHE_SLOPPINESS=pch_defines,time_macros ${TUNESTEAD_CCACHE})
endif()

if(CMAKE_CXX_COMPILER_ID MATCHES "GNU|Clang")
  add_compile_options(-Wall -Wextra -Wpedantic -Wconversion -Wshadow -Wnon-virtual-dtor -Woverloaded-virtual -Werror)
  if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND NOT CMAKE_DISABLE_PRECOMPILE_HEADERS)
    # ccache can only reuse a precompiled header that is the same each time it is built.
    add_compile_options(-fpch-deps -fpch-preprocess)
  endif()
endif()
add_compile_definitions(QT_NO_CAST_FROM_ASCII QT_NO_CAST_TO_ASCII QT_NO_KEYWORDS QT_NO_FOREACH)

# A static library of the engine: sources beside the calling list file, includes from the project's root.
function(tunestead_library name)
  add_library(${name} STATIC ${ARGN})
  target_include_directories(${name} PUBLIC ${PROJECT_SOURCE_DIR})
  tunestead_precompile(${name})
endfunction()

# The engine's libraries share the precompiled header of the first of them.
function(tunestead_precompile target)
  if(target STREQUAL CommonRUKTools)
    target_precompile_headers(${target} PRIVATE ${PROJECT_SOURCE_DIR}/cmake/EnginePrecompiled.h)
  else()
    target_precompile_headers(${target} REUSE_FROM CommonRUKTools)
  endif()
endfunction()
