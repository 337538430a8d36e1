# What `cmake --install` lays down: headers, libraries, plug-ins, the program, a CMake package and a pkg-config file.
# On Windows the folder is moved about as a whole, so all that is needed to run and to build against it lies in it.
include(CMakePackageConfigHelpers)

set(KESTREL_PACKAGE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/kestrel)
# Where a plug-in is found without a path: see kestrel/CMakeLists.txt. Windows looks beside the core.
set(KESTREL_INSTALL_PLUGIN_DIR ${CMAKE_INSTALL_LIBDIR}/kestrel/plugins)
if(WIN32)
  set(KESTREL_INSTALL_PLUGIN_DIR ${CMAKE_INSTALL_BINDIR})
endif()
get_property(plugins GLOBAL PROPERTY KESTREL_PLUGINS)

install(TARGETS kestrel_core EXPORT kestrelTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
install(TARGETS ${plugins} LIBRARY DESTINATION ${KESTREL_INSTALL_PLUGIN_DIR})
# The public headers are those that kestrel/kestrel.h lists.
file(STRINGS ${PROJECT_SOURCE_DIR}/kestrel/kestrel.h headers REGEX "^#include")
list(TRANSFORM headers REPLACE "^#include \"(.*)\"$" "\\1")
foreach(header kestrel/kestrel.h kestrel/translate/PMMLModelTags.inc ${headers})
  cmake_path(GET header PARENT_PATH folder)
  install(FILES ${PROJECT_SOURCE_DIR}/${header} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/${folder})
endforeach()
# For plug-ins of one's own; by itself, because it asks for the XML parser, which hosts have no need of.
install(EXPORT kestrelPluginTargets NAMESPACE kestrel:: DESTINATION ${KESTREL_PACKAGE_DIR})
install(FILES ${CMAKE_CURRENT_LIST_DIR}/KestrelPlugin.cmake ${CMAKE_CURRENT_LIST_DIR}/PluginVersion.cpp
  DESTINATION ${KESTREL_PACKAGE_DIR})
install(FILES ${PROJECT_SOURCE_DIR}/kestrel/model/modeldll.txt DESTINATION ${CMAKE_INSTALL_DATADIR}/kestrel)

install(EXPORT kestrelTargets NAMESPACE kestrel:: DESTINATION ${KESTREL_PACKAGE_DIR})
configure_package_config_file(${CMAKE_CURRENT_LIST_DIR}/kestrelConfig.cmake.in
  ${PROJECT_BINARY_DIR}/kestrelConfig.cmake INSTALL_DESTINATION ${KESTREL_PACKAGE_DIR}
  PATH_VARS KESTREL_INSTALL_PLUGIN_DIR CMAKE_INSTALL_INCLUDEDIR CMAKE_INSTALL_LIBDIR CMAKE_INSTALL_BINDIR)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/kestrelConfigVersion.cmake COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/kestrelConfig.cmake ${PROJECT_BINARY_DIR}/kestrelConfigVersion.cmake
  DESTINATION ${KESTREL_PACKAGE_DIR})

# What is installed and nothing else, for those who want the package out of a tree that has the tests as well.
add_custom_target(package_files DEPENDS kestrel_core kestrel_plugin_support kestrel_program ${plugins})

if(WIN32)
  include(${CMAKE_CURRENT_LIST_DIR}/WindowsPackage.cmake)
else()
  install(FILES ${PROJECT_SOURCE_DIR}/LICENSE ${PROJECT_SOURCE_DIR}/README.md DESTINATION ${CMAKE_INSTALL_DOCDIR})
  # Names the folder that it was installed to, which a package that is moved about cannot.
  configure_file(${CMAKE_CURRENT_LIST_DIR}/kestrel.pc.in ${PROJECT_BINARY_DIR}/kestrel.pc @ONLY)
  install(FILES ${PROJECT_BINARY_DIR}/kestrel.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
endif()
