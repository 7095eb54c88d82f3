# The library is built from layers, one per top-level folder. Each layer is an
# OBJECT library so that a test program can link a layer and the layers below it
# without the rest; the shared library libnorvik.so is the union of all layers.
#
# Platform code lives only in folders named after their platform
# (src/cairo, src/x11, src/headless); scripts/check-layering.sh enforces that
# nothing else includes a platform header.

set(NORVIK_LAYERS tarsel drawbot ui utility controls arrange layout dialogs sharedui automateui)
set(NORVIK_LAYER_DEPS_tarsel "")
set(NORVIK_LAYER_DEPS_drawbot tarsel)
set(NORVIK_LAYER_DEPS_ui tarsel drawbot)
set(NORVIK_LAYER_DEPS_utility tarsel drawbot ui)
set(NORVIK_LAYER_DEPS_controls tarsel drawbot ui utility)
set(NORVIK_LAYER_DEPS_arrange tarsel drawbot ui)
set(NORVIK_LAYER_DEPS_layout tarsel drawbot ui utility controls arrange)
set(NORVIK_LAYER_DEPS_dialogs tarsel drawbot ui utility controls)
set(NORVIK_LAYER_DEPS_sharedui tarsel drawbot ui utility controls)
set(NORVIK_LAYER_DEPS_automateui tarsel drawbot ui utility controls)

set(NORVIK_PRESENT_LAYERS "")

function(norvik_add_layer name)
  file(GLOB_RECURSE _srcs CONFIGURE_DEPENDS
       "${PROJECT_SOURCE_DIR}/${name}/src/*.cpp" "${PROJECT_SOURCE_DIR}/${name}/src/*.c")
  if(NOT _srcs)
    return()
  endif()
  add_library(norvik_${name} OBJECT ${_srcs})
  target_include_directories(norvik_${name} PUBLIC
    $<BUILD_INTERFACE:${PROJECT_SOURCE_DIR}>
    $<BUILD_INTERFACE:${PROJECT_BINARY_DIR}/generated>)
  target_link_libraries(norvik_${name} PUBLIC
    norvik_flags Boost::headers EXPAT::EXPAT nlohmann_json::nlohmann_json
    PkgConfig::CAIRO PkgConfig::PANGO PkgConfig::XCB OpenGL::OpenGL OpenGL::GLX PkgConfig::XLIB JPEG::JPEG
    Threads::Threads ${CMAKE_DL_LIBS})
  foreach(_dep IN LISTS NORVIK_LAYER_DEPS_${name})
    if(TARGET norvik_${_dep})
      target_link_libraries(norvik_${name} PUBLIC norvik_${_dep})
    endif()
  endforeach()
  set(NORVIK_PRESENT_LAYERS ${NORVIK_PRESENT_LAYERS} ${name} PARENT_SCOPE)
endfunction()

# Objects of a layer and of every layer below it, for linking into programs.
function(norvik_layer_objects out name)
  set(_objs "")
  foreach(_dep IN LISTS NORVIK_LAYER_DEPS_${name} ITEMS ${name})
    if(TARGET norvik_${_dep})
      list(APPEND _objs norvik_${_dep})
    endif()
  endforeach()
  if(TARGET norvik_resources)
    list(APPEND _objs norvik_resources)
  endif()
  set(${out} ${_objs} PARENT_SCOPE)
endfunction()

function(norvik_add_library)
  foreach(_layer IN LISTS NORVIK_LAYERS)
    norvik_add_layer(${_layer})
  endforeach()
  set(_objs "")
  foreach(_layer IN LISTS NORVIK_PRESENT_LAYERS)
    list(APPEND _objs $<TARGET_OBJECTS:norvik_${_layer}>)
  endforeach()
  if(TARGET norvik_resources)
    list(APPEND _objs $<TARGET_OBJECTS:norvik_resources>)
  endif()
  add_library(norvik SHARED ${_objs})
  add_library(norvik::norvik ALIAS norvik)
  set_target_properties(norvik PROPERTIES
    VERSION ${PROJECT_VERSION}
    SOVERSION ${PROJECT_VERSION_MAJOR}
    EXPORT_NAME norvik)
  target_include_directories(norvik PUBLIC
    $<BUILD_INTERFACE:${PROJECT_SOURCE_DIR}>
    $<BUILD_INTERFACE:${PROJECT_BINARY_DIR}/generated>
    $<INSTALL_INTERFACE:${CMAKE_INSTALL_INCLUDEDIR}/norvik>)
  target_link_libraries(norvik
    PUBLIC Boost::headers
    PRIVATE norvik_flags EXPAT::EXPAT nlohmann_json::nlohmann_json
            PkgConfig::CAIRO PkgConfig::PANGO PkgConfig::XCB OpenGL::OpenGL OpenGL::GLX PkgConfig::XLIB JPEG::JPEG
            Threads::Threads ${CMAKE_DL_LIBS})
  target_link_options(norvik PRIVATE -Wl,--no-undefined)
  set(NORVIK_PRESENT_LAYERS ${NORVIK_PRESENT_LAYERS} PARENT_SCOPE)
endfunction()
