# Headers that nearly every file reads are compiled once if a preset is built often. The presets without this option (release, tidy, fuzz) see
# each file alone, and fail if it lacks an include.
option(CIMDELTA_PRECOMPILE "Precompile the headers that nearly every file includes" OFF)

# cimdelta_precompiler(NAME HEADER LIBRARIES...): a target that compiles a header of cmake/precompiled/, for others to reuse.
function(cimdelta_precompiler name header)
  if(CIMDELTA_PRECOMPILE)
    add_library(${name} OBJECT ${PROJECT_SOURCE_DIR}/cmake/precompiled/Empty.cpp)
    target_link_libraries(${name} PRIVATE ${ARGN} cimdelta_warnings)
    # What ccache needs to see through a precompiled header.
    target_compile_options(${name} PRIVATE -fpch-preprocess)
    target_precompile_headers(${name} PRIVATE ${PROJECT_SOURCE_DIR}/cmake/precompiled/${header})
  endif()
endfunction()

# cimdelta_precompiled(TARGET PRECOMPILER): the target reads what that one compiled.
function(cimdelta_precompiled target precompiler)
  if(CIMDELTA_PRECOMPILE)
    target_precompile_headers(${target} REUSE_FROM ${precompiler})
    target_compile_options(${target} PRIVATE -fpch-preprocess)
  endif()
endfunction()
