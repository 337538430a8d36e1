# Used by this project and installed with its package, so that everybody's plug-ins are built the same way.

# kestrel_add_plugin(TAG SOURCE...) builds the model library of the model element TAG as the target plugin_TAG. The file
# is called TAG + "800r" + the system's suffix.
function(kestrel_add_plugin tag)
  if(NOT TARGET kestrel::plugin_support)
    message(FATAL_ERROR "kestrel_add_plugin needs the XML parser's development files (Debian: libxerces-c-dev)")
  endif()
  set(target plugin_${tag})
  add_library(${target} MODULE ${ARGN} ${CMAKE_CURRENT_FUNCTION_LIST_DIR}/PluginVersion.cpp)
  target_link_libraries(${target} PRIVATE kestrel::plugin_support)
  # Classes stay hidden, since plug-ins may have some of the same name.
  set_target_properties(${target} PROPERTIES
    PREFIX ""
    OUTPUT_NAME ${tag}800r
    CXX_VISIBILITY_PRESET hidden
    VISIBILITY_INLINES_HIDDEN ON)
endfunction()
