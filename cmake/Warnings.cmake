# The warnings for our own code. Targets link this privately, so users of the libraries do not get the options.
add_library(cimdelta_warnings INTERFACE)
target_compile_options(cimdelta_warnings INTERFACE -Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wnon-virtual-dtor)
if(CIMDELTA_SANITIZE AND CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
  # Instrumented code of the standard library looks uninitialised to GCC 12; the plain build keeps the warning.
  target_compile_options(cimdelta_warnings INTERFACE -Wno-maybe-uninitialized)
endif()
if((CMAKE_UNITY_BUILD OR CIMDELTA_PRECOMPILE) AND CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
  # GCC takes a joined file for a header, and warns of its types that have fields of an unnamed namespace.
  target_compile_options(cimdelta_warnings INTERFACE -Wno-subobject-linkage)
endif()
if(CIMDELTA_WARNINGS_AS_ERRORS)
  target_compile_options(cimdelta_warnings INTERFACE -Werror)
endif()
