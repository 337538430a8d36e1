# What the package holds on Windows besides: the libraries that its programs need and their licences, the parser for
# plug-ins, examples, documents for users; and the zip of it all, which `cpack` writes.

install(FILES ${PROJECT_SOURCE_DIR}/LICENSE DESTINATION licences RENAME Kestrel.txt)
if(KESTREL_WINDOWS_DEPS)
  add_dependencies(package_files windows_runtime)
  install(PROGRAMS ${KESTREL_RUNTIME_LIBRARIES} DESTINATION ${CMAKE_INSTALL_BINDIR})
  # Core and plug-ins share one parser, so plug-ins of others are built with this one.
  install(DIRECTORY ${KESTREL_WINDOWS_DEPS}/include/xercesc DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
  install(FILES ${KESTREL_WINDOWS_DEPS}/lib/libxerces-c.dll.a DESTINATION ${CMAKE_INSTALL_LIBDIR})
  install(DIRECTORY ${KESTREL_WINDOWS_DEPS}/licences/ DESTINATION licences)
  foreach(licence ${KESTREL_RUNTIME_LICENCES})
    string(REPLACE "=" ";" licence ${licence})
    list(GET licence 0 name)
    list(GET licence 1 file)
    install(FILES ${file} DESTINATION licences RENAME ${name})
  endforeach()
endif()

# Line ends as the system's own editor has always known them.
configure_file(${PROJECT_SOURCE_DIR}/tools/windows/README.txt.in ${PROJECT_BINARY_DIR}/README.txt
  @ONLY NEWLINE_STYLE DOS)
install(FILES ${PROJECT_BINARY_DIR}/README.txt DESTINATION .)
foreach(document windows program documents functions errors operations accuracy plugin-guide)
  install(FILES ${PROJECT_SOURCE_DIR}/docs/${document}.md DESTINATION ${CMAKE_INSTALL_DOCDIR})
endforeach()
# Without the scripts that fitted the models.
install(DIRECTORY ${PROJECT_SOURCE_DIR}/examples DESTINATION .
  FILES_MATCHING PATTERN *.xml PATTERN *.csv PATTERN *.md PATTERN host/* PATTERN fit EXCLUDE)

# Of a project that takes this one in, the package is its own affair.
if(PROJECT_IS_TOP_LEVEL)
  set(CPACK_GENERATOR ZIP)
  set(CPACK_PACKAGE_FILE_NAME kestrel-${PROJECT_VERSION}-windows-x64)
  set(CPACK_STRIP_FILES ON)
  set(CPACK_VERBATIM_VARIABLES ON)
  include(CPack)
endif()
