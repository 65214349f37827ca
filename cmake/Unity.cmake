# Where CMAKE_UNITY_BUILD is on, the sources of a folder are compiled as one, which takes a quarter of the
# time. A folder is one topic, so two of its files have no reason to define the same helper.
function(orn_hdl_unite_folders target)
  get_target_property(sources ${target} SOURCES)
  foreach(source IN LISTS sources)
    if(source MATCHES "\\.cpp$")
      cmake_path(ABSOLUTE_PATH source OUTPUT_VARIABLE folder)
      cmake_path(RELATIVE_PATH folder BASE_DIRECTORY ${PROJECT_SOURCE_DIR})
      cmake_path(GET folder PARENT_PATH folder)
      string(MAKE_C_IDENTIFIER "${folder}" folder)
      set_source_files_properties(${source} PROPERTIES UNITY_GROUP ${folder})
    endif()
  endforeach()
  set_target_properties(${target} PROPERTIES UNITY_BUILD_MODE GROUP)
  if(CMAKE_UNITY_BUILD AND CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    # GCC takes a source that another one includes for a header.
    target_compile_options(${target} PRIVATE -Wno-subobject-linkage)
  endif()
endfunction()
