# The exported names of the library, the files that `cmake --install` installs, and the packages.
# Installed files find each other by relative paths, so that a prefix can be moved.

option(ORN_HDL_INSTALL "Install the library and the tool" ${PROJECT_IS_TOP_LEVEL})
set(ORN_HDL_ZSH_DIR ${CMAKE_INSTALL_DATADIR}/zsh/site-functions CACHE STRING
    "Where the completion for zsh is installed")
set(ORN_HDL_TOOL_DOCDIR ${CMAKE_INSTALL_DOCDIR} CACHE STRING
    "Where the pages for users of the tool are installed")
mark_as_advanced(ORN_HDL_ZSH_DIR ORN_HDL_TOOL_DOCDIR)

if(BUILD_SHARED_LIBS AND UNIX AND NOT APPLE)
  set(orn_hdl_exports ${CMAKE_CURRENT_LIST_DIR}/exports.map)
  target_link_options(Orn_Hdl PRIVATE LINKER:--version-script=${orn_hdl_exports})
  set_target_properties(Orn_Hdl PROPERTIES LINK_DEPENDS ${orn_hdl_exports})
endif()

if(NOT ORN_HDL_INSTALL)
  return()
endif()

# The library, for running programs and for building them.
set(orn_hdl_cmake_dir ${CMAKE_INSTALL_LIBDIR}/cmake/Orn_Hdl)
install(TARGETS Orn_Hdl EXPORT Orn_HdlTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT Library NAMELINK_COMPONENT Development
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT Development)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/ DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}
  COMPONENT Development FILES_MATCHING PATTERN "*.h")

install(EXPORT Orn_HdlTargets NAMESPACE Orn_Hdl:: DESTINATION ${orn_hdl_cmake_dir}
  COMPONENT Development)
configure_package_config_file(${CMAKE_CURRENT_LIST_DIR}/Orn_HdlConfig.cmake.in
  ${PROJECT_BINARY_DIR}/Orn_HdlConfig.cmake INSTALL_DESTINATION ${orn_hdl_cmake_dir}
  NO_SET_AND_CHECK_MACRO)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/Orn_HdlConfigVersion.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/Orn_HdlConfig.cmake
              ${PROJECT_BINARY_DIR}/Orn_HdlConfigVersion.cmake
  DESTINATION ${orn_hdl_cmake_dir} COMPONENT Development)

file(RELATIVE_PATH ORN_HDL_PC_PREFIX ${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig
     ${CMAKE_INSTALL_PREFIX})
file(RELATIVE_PATH ORN_HDL_PC_LIBDIR ${CMAKE_INSTALL_PREFIX} ${CMAKE_INSTALL_FULL_LIBDIR})
file(RELATIVE_PATH ORN_HDL_PC_INCLUDEDIR ${CMAKE_INSTALL_PREFIX} ${CMAKE_INSTALL_FULL_INCLUDEDIR})
if(BUILD_SHARED_LIBS)
  set(ORN_HDL_PC_STATIC "")
  set(ORN_HDL_PC_PRIVATE "")
else()
  set(ORN_HDL_PC_STATIC " -DORN_HDL_STATIC")
  # For programs in C, which are not linked with the C++ library by themselves.
  set(ORN_HDL_PC_PRIVATE "\nLibs.private: -lstdc++ -lm -pthread")
endif()
configure_file(${CMAKE_CURRENT_LIST_DIR}/orn_hdl.pc.in ${PROJECT_BINARY_DIR}/orn_hdl.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/orn_hdl.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig
  COMPONENT Development)

install(DIRECTORY ${PROJECT_SOURCE_DIR}/examples DESTINATION ${CMAKE_INSTALL_DOCDIR}
  COMPONENT Development PATTERN "__pycache__" EXCLUDE)
install(FILES ${PROJECT_SOURCE_DIR}/docs/interface.md ${PROJECT_SOURCE_DIR}/docs/c.md
  DESTINATION ${CMAKE_INSTALL_DOCDIR}
  COMPONENT Development)

# The tool, its manual pages, its pages for users, and support for shells and editors.
if(TARGET orn-hdl)
  file(RELATIVE_PATH orn_hdl_libraries ${CMAKE_INSTALL_FULL_BINDIR} ${CMAKE_INSTALL_FULL_LIBDIR})
  if(BUILD_SHARED_LIBS)
    set_target_properties(orn-hdl PROPERTIES INSTALL_RPATH "$ORIGIN/${orn_hdl_libraries}")
  endif()
  install(TARGETS orn-hdl RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT Tool)
  set(orn_hdl_share ${PROJECT_SOURCE_DIR}/share)
  set(orn_hdl_pages tutorial.md commands.md messages.md warnings.md formats.md import.md limits.md
    cookbook.md)
  install(DIRECTORY ${orn_hdl_share}/man/ DESTINATION ${CMAKE_INSTALL_MANDIR} COMPONENT Tool)
  install(DIRECTORY ${orn_hdl_share}/bash-completion ${orn_hdl_share}/vim ${orn_hdl_share}/orn-hdl
    DESTINATION ${CMAKE_INSTALL_DATADIR} COMPONENT Tool)
  install(FILES ${orn_hdl_share}/zsh/_orn-hdl DESTINATION ${ORN_HDL_ZSH_DIR} COMPONENT Tool)
  list(TRANSFORM orn_hdl_pages PREPEND ${PROJECT_SOURCE_DIR}/docs/)
  install(FILES ${orn_hdl_pages} DESTINATION ${ORN_HDL_TOOL_DOCDIR} COMPONENT Tool)
endif()

# The Python package, beside the library and once more as a folder that needs nothing beside it, for a wheel.
if(TARGET orn_hdl_python)
  set(ORN_HDL_PYTHON_DIR lib/python3/dist-packages CACHE STRING "Where the Python package is installed")
  mark_as_advanced(ORN_HDL_PYTHON_DIR)
  cmake_path(ABSOLUTE_PATH ORN_HDL_PYTHON_DIR BASE_DIRECTORY ${CMAKE_INSTALL_PREFIX} OUTPUT_VARIABLE orn_hdl_python_dir)
  file(RELATIVE_PATH orn_hdl_libraries ${orn_hdl_python_dir}/orn_hdl ${CMAKE_INSTALL_FULL_LIBDIR})
  set_target_properties(orn_hdl_python PROPERTIES
    INSTALL_RPATH "$ORIGIN/${CMAKE_INSTALL_LIBDIR};$ORIGIN/${orn_hdl_libraries}")
  set(orn_hdl_python_source ${PROJECT_SOURCE_DIR}/python/orn_hdl/)
  install(TARGETS orn_hdl_python LIBRARY DESTINATION ${ORN_HDL_PYTHON_DIR}/orn_hdl COMPONENT Python)
  install(DIRECTORY ${orn_hdl_python_source} DESTINATION ${ORN_HDL_PYTHON_DIR}/orn_hdl COMPONENT Python
    FILES_MATCHING PATTERN "*.py" PATTERN "*.pyi" PATTERN "py.typed" PATTERN "__pycache__" EXCLUDE)
  install(TARGETS orn_hdl_python LIBRARY DESTINATION orn_hdl COMPONENT Wheel EXCLUDE_FROM_ALL)
  install(DIRECTORY ${orn_hdl_python_source} DESTINATION orn_hdl COMPONENT Wheel EXCLUDE_FROM_ALL
    FILES_MATCHING PATTERN "*.py" PATTERN "*.pyi" PATTERN "py.typed" PATTERN "__pycache__" EXCLUDE)
  if(BUILD_SHARED_LIBS)
    install(TARGETS Orn_Hdl LIBRARY DESTINATION orn_hdl/${CMAKE_INSTALL_LIBDIR} COMPONENT Wheel EXCLUDE_FROM_ALL
      NAMELINK_SKIP)
  endif()
  if(TARGET orn-hdl)
    install(TARGETS orn-hdl RUNTIME DESTINATION orn_hdl/bin COMPONENT Wheel EXCLUDE_FROM_ALL)
  endif()
endif()

if(PROJECT_IS_TOP_LEVEL)
  include(${CMAKE_CURRENT_LIST_DIR}/Package.cmake)
endif()
