# Debian packages, made by CPack from the installed components: packaging/build-debian runs it.

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME orn-hdl)
set(CPACK_PACKAGE_VENDOR "the Orn_Hdl authors")
set(CPACK_PACKAGE_CONTACT "The Orn_Hdl authors <orn-hdl@example.org>")
set(CPACK_COMPONENTS_ALL Library Development Tool)
if(TARGET orn_hdl_python)
  list(APPEND CPACK_COMPONENTS_ALL Python)
endif()
if(ORN_HDL_BUILD_TCL)
  list(APPEND CPACK_COMPONENTS_ALL Tcl)
endif()
set(CPACK_STRIP_FILES ON)
# Each package has a description of its own.
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")
set(CPACK_PRE_BUILD_SCRIPTS ${PROJECT_SOURCE_DIR}/packaging/complete-debian.cmake)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
    OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)

set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_PACKAGE_RELEASE 1)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${PROJECT_BINARY_DIR})
set(CPACK_DEBIAN_ENABLE_COMPONENT_DEPENDS ON)
set(CPACK_COMPONENT_DEVELOPMENT_DEPENDS Library)
set(CPACK_COMPONENT_TOOL_DEPENDS Library)
set(CPACK_COMPONENT_PYTHON_DEPENDS Library)
set(CPACK_COMPONENT_TCL_DEPENDS Library)

set(CPACK_DEBIAN_LIBRARY_PACKAGE_NAME liborn-hdl${PROJECT_VERSION_MAJOR})
set(CPACK_DEBIAN_LIBRARY_PACKAGE_SECTION libs)
# The dependency for packages of programs that link the library, and the trigger for ldconfig.
set(orn_hdl_shlibs ${PROJECT_BINARY_DIR}/debian-control/shlibs)
set(orn_hdl_triggers ${PROJECT_BINARY_DIR}/debian-control/triggers)
file(WRITE ${orn_hdl_shlibs} "libOrn_Hdl ${PROJECT_VERSION_MAJOR} "
     "${CPACK_DEBIAN_LIBRARY_PACKAGE_NAME} (>= ${PROJECT_VERSION})\n")
file(WRITE ${orn_hdl_triggers} "activate-noawait ldconfig\n")
set(CPACK_DEBIAN_LIBRARY_PACKAGE_CONTROL_EXTRA ${orn_hdl_shlibs} ${orn_hdl_triggers})
set(CPACK_COMPONENT_LIBRARY_DESCRIPTION
"writes structural netlists (shared library)
Builds flat hardware designs in memory, through text commands or a C++
or C interface, and writes them as structural Verilog and VHDL.")

set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_NAME liborn-hdl-dev)
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_SECTION libdevel)
set(CPACK_COMPONENT_DEVELOPMENT_DESCRIPTION
"writes structural netlists (development files)
Headers, CMake package, pkg-config file and examples for programs that
build hardware designs in memory and write them as structural Verilog and
VHDL.")

set(CPACK_DEBIAN_TOOL_PACKAGE_NAME orn-hdl)
set(CPACK_DEBIAN_TOOL_PACKAGE_SECTION electronics)
# "orn-hdl draw" runs dot.
set(CPACK_DEBIAN_TOOL_PACKAGE_RECOMMENDS graphviz)
set(CPACK_COMPONENT_TOOL_DESCRIPTION
"writes structural netlists from command files
Replays files of commands that describe a flat hardware design and writes
it as structural Verilog and VHDL. Imports netlists from Yosys and draws
them with Graphviz.")

set(CPACK_DEBIAN_PYTHON_PACKAGE_NAME python3-orn-hdl)
set(CPACK_DEBIAN_PYTHON_PACKAGE_SECTION python)
set(CPACK_DEBIAN_PYTHON_PACKAGE_DEPENDS "python3 (>= 3.9)")
set(CPACK_DEBIAN_PYTHON_PACKAGE_CONTROL_EXTRA ${PROJECT_SOURCE_DIR}/packaging/python3/postinst
    ${PROJECT_SOURCE_DIR}/packaging/python3/prerm)
# It imports JSON and draws with the tool.
set(CPACK_DEBIAN_PYTHON_PACKAGE_RECOMMENDS orn-hdl)
set(CPACK_DEBIAN_PYTHON_PACKAGE_SUGGESTS "python3-networkx, python3-numpy, python3-pandas")
set(CPACK_COMPONENT_PYTHON_DESCRIPTION
"writes structural netlists (Python 3 package)
Builds flat hardware designs from Python, reads structural Verilog and
VHDL, and writes both.")

set(CPACK_DEBIAN_TCL_PACKAGE_NAME tcl-orn-hdl)
set(CPACK_DEBIAN_TCL_PACKAGE_SECTION interpreters)
set(CPACK_DEBIAN_TCL_PACKAGE_DEPENDS "tcl8.6 | tclsh")
set(CPACK_COMPONENT_TCL_DESCRIPTION
"writes structural netlists (package for Tcl)
Builds flat hardware designs in Tcl, by text commands, and writes them as
structural Verilog and VHDL.")

include(CPack)
