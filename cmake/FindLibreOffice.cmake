# LibreOffice's development kit: headers, libraries, and a C++ header for each UNO type, made when the project is built.
#   LibreOffice::Uno   target to link against
#   LIBREOFFICE_HOME   where LibreOffice lies

set(LIBREOFFICE_HOME /usr/lib/libreoffice CACHE PATH "LibreOffice's folder, with program/ and sdk/ in it")
find_program(LibreOffice_cppumaker cppumaker PATHS ${LIBREOFFICE_HOME}/sdk/bin NO_DEFAULT_PATH)
find_path(LibreOffice_include rtl/ustring.hxx PATHS ${LIBREOFFICE_HOME}/sdk/include NO_DEFAULT_PATH)
set(LibreOffice_libraries)
foreach(name IN ITEMS uno_sal uno_cppu uno_cppuhelpergcc3)
  find_library(LibreOffice_${name} ${name} PATHS ${LIBREOFFICE_HOME}/sdk/lib NO_DEFAULT_PATH)
  list(APPEND LibreOffice_libraries LibreOffice_${name})
endforeach()

include(FindPackageHandleStandardArgs)
find_package_handle_standard_args(LibreOffice
  REQUIRED_VARS LibreOffice_cppumaker LibreOffice_include ${LibreOffice_libraries}
  REASON_FAILURE_MESSAGE "its development kit comes with the package libreoffice-dev")

if(LibreOffice_FOUND AND NOT TARGET LibreOffice::Uno)
  set(types ${LIBREOFFICE_HOME}/program/types.rdb ${LIBREOFFICE_HOME}/program/types/offapi.rdb)
  set(headers ${CMAKE_BINARY_DIR}/uno)
  file(MAKE_DIRECTORY ${headers})
  add_custom_command(
    OUTPUT ${headers}/made
    COMMAND ${LibreOffice_cppumaker} -Gc -O${headers} ${types}
    COMMAND ${CMAKE_COMMAND} -E touch ${headers}/made
    DEPENDS ${types}
    COMMENT "C++ headers of LibreOffice's types"
    VERBATIM)
  add_custom_target(libreoffice_headers DEPENDS ${headers}/made)
  add_library(LibreOffice::Uno INTERFACE IMPORTED GLOBAL)
  add_dependencies(LibreOffice::Uno libreoffice_headers)
  target_include_directories(LibreOffice::Uno SYSTEM INTERFACE ${LibreOffice_include} ${headers})
  target_compile_definitions(LibreOffice::Uno INTERFACE CPPU_ENV=gcc3 LINUX UNX)
  foreach(library IN LISTS LibreOffice_libraries)
    target_link_libraries(LibreOffice::Uno INTERFACE ${${library}})
  endforeach()
endif()
