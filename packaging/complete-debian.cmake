# Run by CPack for each staged package: adds the files that Debian requires in every package, and
# compresses its manual pages.

if(NOT CPACK_GENERATOR STREQUAL "DEB")
  return()
endif()

set(packages Library=${CPACK_DEBIAN_LIBRARY_PACKAGE_NAME}
             Development=${CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME}
             Tool=${CPACK_DEBIAN_TOOL_PACKAGE_NAME}
             Python=${CPACK_DEBIAN_PYTHON_PACKAGE_NAME}
             Tcl=${CPACK_DEBIAN_TCL_PACKAGE_NAME})
foreach(pair ${packages})
  string(REGEX MATCH "^([^=]*)=(.*)$" pair ${pair})
  set(root ${CPACK_TEMPORARY_INSTALL_DIRECTORY}/${CMAKE_MATCH_1}/usr/share)
  set(documents ${root}/doc/${CMAKE_MATCH_2})
  file(MAKE_DIRECTORY ${documents})
  file(COPY_FILE ${CMAKE_CURRENT_LIST_DIR}/copyright ${documents}/copyright)
  file(COPY_FILE ${CMAKE_CURRENT_LIST_DIR}/changelog ${documents}/changelog.Debian)
  file(GLOB manuals ${root}/man/man*/*)
  execute_process(COMMAND gzip --best --no-name ${documents}/changelog.Debian ${manuals}
                  COMMAND_ERROR_IS_FATAL ANY)
endforeach()
