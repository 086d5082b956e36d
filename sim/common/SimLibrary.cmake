# ftx_sim_library(TARGET OUTPUT SOURCES ... EXPORT pattern... [HIDE symbol...] [VARIANT name]):
# one simulated handset library named exactly OUTPUT (e.g. lib_factory.so) in <build>/lib
# exporting only the EXPORT names (globs allowed) and ftx_sim_control, or, with VARIANT, in
# <build>/lib/variants/<name>/ with the HIDE symbols also left out, so dlsym cannot find
# them (the binding tests).
function(ftx_sim_library target output)
  cmake_parse_arguments(A "" "VARIANT" "SOURCES;HIDE;EXPORT" ${ARGN})
  add_library(${target} SHARED ${A_SOURCES})
  target_link_libraries(${target} PRIVATE ftxsim ftxplatform Threads::Threads)
  set_target_properties(${target} PROPERTIES PREFIX "" OUTPUT_NAME ${output} SUFFIX "")
  if(A_VARIANT)
    set(dir ${CMAKE_LIBRARY_OUTPUT_DIRECTORY}/variants/${A_VARIANT})
    set_target_properties(${target} PROPERTIES LIBRARY_OUTPUT_DIRECTORY ${dir})
  endif()
  set(script ${CMAKE_CURRENT_BINARY_DIR}/${target}.map)
  if(A_HIDE)
    list(REMOVE_ITEM A_EXPORT ${A_HIDE})
  endif()
  list(JOIN A_EXPORT "; " exported)
  set(hidden "")
  if(A_HIDE)
    list(JOIN A_HIDE "; " hidden)
    set(hidden "${hidden}; ")
  endif()
  file(WRITE ${script} "{ global: ${exported}; ftx_sim_control; local: ${hidden}*; };\n")
  target_link_options(${target} PRIVATE -Wl,--version-script=${script})
  set_property(TARGET ${target} APPEND PROPERTY LINK_DEPENDS ${script})
endfunction()
