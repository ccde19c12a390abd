# What is installed, and packed into a ZIP named after version and platform. The version is the project's everywhere.
include(CMakePackageConfigHelpers)

set(HEADER_FOLDER ${CMAKE_INSTALL_INCLUDEDIR}/frontpanels)
set(CONFIG_FOLDER ${CMAKE_INSTALL_LIBDIR}/cmake/frontpanels)
if(WIN32)
  math(EXPR width "8 * ${CMAKE_SIZEOF_VOID_P}")
  set(PACKAGE_PLATFORM "Windows, ${width} bit")
  set(PACKAGE_SUFFIX win${width})
  set(FOREIGN_ROOM raster)
else()
  set(PACKAGE_PLATFORM "${CMAKE_SYSTEM_NAME}, ${CMAKE_SYSTEM_PROCESSOR}")
  string(TOLOWER ${CMAKE_SYSTEM_NAME}-${CMAKE_SYSTEM_PROCESSOR} PACKAGE_SUFFIX)
  set(FOREIGN_ROOM win32)
endif()

# --- Libraries: library | export set. Raster stands apart because it needs other packages.
foreach(row core|targets sources|targets win32|targets raster|raster-targets)
  string(REPLACE "|" ";" row ${row})
  list(POP_FRONT row library set)
  if(TARGET frontpanels_${library})
    set_target_properties(frontpanels_${library} PROPERTIES EXPORT_NAME ${library})
    install(TARGETS frontpanels_${library} EXPORT frontpanels-${set} ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR})
    list(APPEND export_sets ${set})
  endif()
endforeach()
list(REMOVE_DUPLICATES export_sets)
foreach(set ${export_sets})
  install(EXPORT frontpanels-${set} NAMESPACE frontpanels:: DESTINATION ${CONFIG_FOLDER})
endforeach()
install(DIRECTORY platform framework traces painters entry spectrum pilot sources DESTINATION ${HEADER_FOLDER}
  FILES_MATCHING PATTERN "*.h" PATTERN ${FOREIGN_ROOM} EXCLUDE)

configure_package_config_file(cmake/frontpanels-config.cmake.in ${PROJECT_BINARY_DIR}/frontpanels-config.cmake
  INSTALL_DESTINATION ${CONFIG_FOLDER})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/frontpanels-config-version.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/frontpanels-config.cmake ${PROJECT_BINARY_DIR}/frontpanels-config-version.cmake
  DESTINATION ${CONFIG_FOLDER})

# --- Programs, and the control with what hosts need to know of it
if(WIN32)
  install(TARGETS frontpanels_ocx workbench RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
  install(FILES ${PROJECT_BINARY_DIR}/activex/frontpanels.tlb ${PROJECT_BINARY_DIR}/FrontPanels.Controls.manifest
    DESTINATION ${CMAKE_INSTALL_BINDIR})
  install(FILES ${PROJECT_BINARY_DIR}/activex/frontpanels_h.h activex/axbase.h DESTINATION ${HEADER_FOLDER})
  # The workbench looks for recordings beside itself.
  install(DIRECTORY recordings DESTINATION ${CMAKE_INSTALL_BINDIR})
else()
  install(TARGETS fp-render RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})
  install(DIRECTORY recordings DESTINATION ${CMAKE_INSTALL_DATADIR}/frontpanels)
endif()

# --- Documentation
configure_file(cmake/PACKAGE.txt.in ${PROJECT_BINARY_DIR}/PACKAGE.txt @ONLY)
install(FILES README.md ARCHITECTURE.md ${PROJECT_BINARY_DIR}/PACKAGE.txt DESTINATION ${CMAKE_INSTALL_DOCDIR})
foreach(folder docs examples)
  if(IS_DIRECTORY ${PROJECT_SOURCE_DIR}/${folder})
    install(DIRECTORY ${folder} DESTINATION ${CMAKE_INSTALL_DOCDIR})
  endif()
endforeach()

set(CPACK_GENERATOR ZIP)
set(CPACK_PACKAGE_NAME frontpanels)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_PACKAGE_FILE_NAME frontpanels-${PROJECT_VERSION}-${PACKAGE_SUFFIX})
set(CPACK_VERBATIM_VARIABLES ON)
include(CPack)
