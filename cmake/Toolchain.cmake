# The one place for language level, warnings, sanitizers and the libraries of the host.
set(CMAKE_CXX_STANDARD 17)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS ON)
set(CMAKE_C_STANDARD 11)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/lib)

if(CMAKE_BUILD_WITH_INSTALL_RPATH)
  # Programs that will find their libraries where they are installed are linked before that.
  add_link_options(-Wl,-rpath-link,${CMAKE_LIBRARY_OUTPUT_DIRECTORY})
endif()

add_compile_options(-Wall -Wextra -Wformat=2)
if(ZELQO_SANITIZE)
  add_compile_options(-fsanitize=address,undefined -fno-omit-frame-pointer)
  add_link_options(-fsanitize=address,undefined)
endif()

if(ZELQO_FUZZ)
  add_compile_options(-fsanitize=fuzzer-no-link,address,undefined -fno-sanitize-recover=undefined)
  add_link_options(-fsanitize=address,undefined)
endif()

find_package(PkgConfig REQUIRED)
# pkg_import(NAME MODULE...): pkg-config modules as the imported target pkg::NAME. Their headers
# are system headers, so that only our own code has to be free of warnings.
function(pkg_import name)
  if(NOT TARGET PkgConfig::${name})
    pkg_check_modules(${name} REQUIRED IMPORTED_TARGET GLOBAL ${ARGN})
    # Debian's ector.pc names a folder that no package has, which CMake would refuse.
    set(folders ${${name}_INCLUDE_DIRS})
    list(FILTER folders EXCLUDE REGEX "/ector-1$")
    set_target_properties(PkgConfig::${name} PROPERTIES INTERFACE_INCLUDE_DIRECTORIES "${folders}")
    add_library(pkg::${name} ALIAS PkgConfig::${name})
  endif()
endfunction()

pkg_import(efl elementary ecore-x edje evas ecore ecore-evas ecore-file eina)
pkg_import(glib gio-unix-2.0 glib-2.0)
pkg_import(json json-glib-1.0)
pkg_import(icu icu-i18n icu-uc)
if(ZELQO_PLATFORM STREQUAL host)
  pkg_import(sqlite sqlite3)
  pkg_import(soup libsoup-3.0)
endif()

find_program(EDJE_CC edje_cc REQUIRED)
find_program(RSVG_CONVERT rsvg-convert REQUIRED)
find_program(MSGFMT msgfmt REQUIRED)
find_program(MSGCAT msgcat REQUIRED)
