# What has to lie beside the programs on Windows: the parser's and ICU's libraries and the compiler's. One C++ runtime as
# DLLs, because programs and plug-ins that have one each cannot rethrow each other's exceptions. The target
# windows_runtime puts them there, without the debug data that makes the compiler's ten times as large.
file(GLOB libraries ${KESTREL_WINDOWS_DEPS}/bin/*.dll)
foreach(name libstdc++-6.dll libgcc_s_seh-1.dll libwinpthread-1.dll)
  execute_process(COMMAND ${CMAKE_CXX_COMPILER} -print-file-name=${name}
    OUTPUT_VARIABLE library OUTPUT_STRIP_TRAILING_WHITESPACE)
  if(NOT IS_ABSOLUTE "${library}")
    message(FATAL_ERROR "The compiler does not know where its ${name} is")
  endif()
  list(APPEND libraries ${library})
endforeach()

set(KESTREL_RUNTIME_LIBRARIES)
foreach(library ${libraries})
  cmake_path(GET library FILENAME name)
  set(copy ${CMAKE_RUNTIME_OUTPUT_DIRECTORY}/${name})
  add_custom_command(OUTPUT ${copy} COMMAND ${CMAKE_STRIP} -o ${copy} ${library} DEPENDS ${library} VERBATIM)
  list(APPEND KESTREL_RUNTIME_LIBRARIES ${copy})
endforeach()
add_custom_target(windows_runtime ALL DEPENDS ${KESTREL_RUNTIME_LIBRARIES})

# The licences of the compiler's libraries, as NAME=FILE. GCC's is the GPL with an exception that its text explains.
set(KESTREL_RUNTIME_LICENCES
  GCC-runtime.txt=/usr/share/doc/gcc-mingw-w64-base/copyright
  GPL-3.txt=/usr/share/common-licenses/GPL-3
  mingw-w64.txt=/usr/share/doc/mingw-w64-x86-64-dev/copyright)
