# Where CMAKE_UNITY_BUILD is on, the sources of a folder are compiled as one, which takes a quarter of the
# time. A folder is one topic, so two of its files have no reason to define the same helper.
function(orn_hdl_unite_folders target)
  get_target_property(sources ${target} SOURCES)
  foreach(source IN LISTS sources)
    if(source MATCHES "\\.cpp$")
      cmake_path(GET source PARENT_PATH folder)
      set_source_files_properties(${source} PROPERTIES UNITY_GROUP "folder ${folder}")
    endif()
  endforeach()
  set_target_properties(${target} PROPERTIES UNITY_BUILD_MODE GROUP)
endfunction()
