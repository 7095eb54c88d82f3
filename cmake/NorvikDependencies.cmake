# Every dependency comes from a Debian package (scripts/install-deps.sh).
find_package(Boost 1.74 REQUIRED)
find_package(EXPAT REQUIRED)
find_package(nlohmann_json 3 REQUIRED)
find_package(PkgConfig REQUIRED)
pkg_check_modules(CAIRO REQUIRED IMPORTED_TARGET cairo cairo-xcb cairo-png)
pkg_check_modules(PANGO REQUIRED IMPORTED_TARGET pangocairo pangoft2 fontconfig)
pkg_check_modules(XCB REQUIRED IMPORTED_TARGET
  xcb xcb-randr xcb-xkb xcb-xtest xcb-shape xcb-render xcb-cursor xcb-xfixes xcb-icccm
  xkbcommon xkbcommon-x11)
# OpenGL views draw through GLX, which speaks through an Xlib display.
find_package(OpenGL REQUIRED COMPONENTS OpenGL GLX)
pkg_check_modules(XLIB REQUIRED IMPORTED_TARGET x11)
find_package(JPEG REQUIRED)
find_package(Threads REQUIRED)
