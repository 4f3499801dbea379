# cimdelta_run_often(TARGET): sources that sweeps run thousands of times, which makes them worth optimising. They cannot read headers that are
# precompiled without optimisation.
function(cimdelta_run_often target)
  if(CMAKE_BUILD_TYPE STREQUAL "Debug")
    target_compile_options(${target} PRIVATE -O1)
  endif()
endfunction()
