# Installation: the shared library, the public headers of every layer, a CMake
# package (find_package(norvik) -> norvik::norvik) and a pkg-config file.
include(CMakePackageConfigHelpers)

install(TARGETS norvik EXPORT norvikTargets
  LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR}
  ARCHIVE DESTINATION ${CMAKE_INSTALL_LIBDIR}
  RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})

foreach(_layer IN LISTS NORVIK_LAYERS)
  if(IS_DIRECTORY "${PROJECT_SOURCE_DIR}/${_layer}")
    install(DIRECTORY "${PROJECT_SOURCE_DIR}/${_layer}/"
      DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/norvik/${_layer}
      FILES_MATCHING PATTERN "*.h"
      PATTERN "src" EXCLUDE)
  endif()
endforeach()

install(EXPORT norvikTargets NAMESPACE norvik::
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/norvik)
configure_package_config_file(cmake/norvikConfig.cmake.in
  ${PROJECT_BINARY_DIR}/norvikConfig.cmake
  INSTALL_DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/norvik)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/norvikConfigVersion.cmake
  COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/norvikConfig.cmake ${PROJECT_BINARY_DIR}/norvikConfigVersion.cmake
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/cmake/norvik)

configure_file(cmake/norvik.pc.in ${PROJECT_BINARY_DIR}/norvik.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/norvik.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
