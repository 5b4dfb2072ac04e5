# Generates <velkcore/velkcore.h> and <velkui/velkui.h>, which include every
# public header, so that they never fall behind the headers themselves.
set(VELKUI_GENERATED_INCLUDE ${PROJECT_BINARY_DIR}/generated/include)

function(velkui_write_umbrella output guard_comment)
  set(content "#pragma once\n\n// ${guard_comment}\n// Generated at configure time from the public headers.\n\n")
  foreach(header IN LISTS ARGN)
    string(APPEND content "#include <${header}>\n")
  endforeach()
  file(CONFIGURE OUTPUT ${VELKUI_GENERATED_INCLUDE}/${output} CONTENT "${content}" @ONLY)
endfunction()

file(GLOB_RECURSE core_headers CONFIGURE_DEPENDS RELATIVE ${PROJECT_SOURCE_DIR}/core/include
  ${PROJECT_SOURCE_DIR}/core/include/velkcore/*.h)
list(REMOVE_ITEM core_headers velkcore/velkcore.h)
list(SORT core_headers)
velkui_write_umbrella(velkcore/velkcore.h "The whole public interface of velkcore." ${core_headers})

set(ui_headers "")
foreach(subsystem utility pictel ui arrange layout controls automateui dialogs utils datatransfer sharedui)
  if(EXISTS ${PROJECT_SOURCE_DIR}/${subsystem}/include)
    file(GLOB_RECURSE headers CONFIGURE_DEPENDS RELATIVE ${PROJECT_SOURCE_DIR}/${subsystem}/include
      ${PROJECT_SOURCE_DIR}/${subsystem}/include/velkui/*.h)
    list(APPEND ui_headers ${headers})
  endif()
endforeach()
list(SORT ui_headers)
velkui_write_umbrella(velkui/velkui.h "The whole public interface of velkui (and velkcore)."
  velkcore/velkcore.h ${ui_headers})

target_include_directories(velkcore PUBLIC $<BUILD_INTERFACE:${VELKUI_GENERATED_INCLUDE}>)
install(DIRECTORY ${VELKUI_GENERATED_INCLUDE}/ DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
