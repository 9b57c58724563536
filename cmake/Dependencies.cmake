# GoogleTest: Debian's build natively; for the MinGW cross build, built here
# from Debian's sources; on Windows itself, the toolchain's own package.
if(WIN32 AND EXISTS /usr/src/googletest/CMakeLists.txt)
  set(gtest_force_shared_crt OFF CACHE BOOL "" FORCE)
  set(INSTALL_GTEST OFF CACHE BOOL "" FORCE)
  set(BUILD_GMOCK OFF CACHE BOOL "" FORCE)
  add_subdirectory(/usr/src/googletest ${CMAKE_BINARY_DIR}/googletest EXCLUDE_FROM_ALL)
  add_library(vek_gtest_main INTERFACE)
  target_link_libraries(vek_gtest_main INTERFACE gtest_main)
else()
  find_package(GTest REQUIRED)
  add_library(vek_gtest_main INTERFACE)
  target_link_libraries(vek_gtest_main INTERFACE GTest::gtest_main)
endif()

# libvorbisfile: Debian's natively; for Windows the static libraries under
# VEK_MINGW_DEPS (tools/setup-deps builds them into .deps/mingw).
if(WIN32)
  set(VEK_MINGW_DEPS ${PROJECT_SOURCE_DIR}/.deps/mingw CACHE PATH "Prefix of the MinGW libogg and libvorbis")
  if(NOT EXISTS ${VEK_MINGW_DEPS}/lib/libvorbisfile.a)
    message(FATAL_ERROR "libvorbis for MinGW is missing under ${VEK_MINGW_DEPS}: run tools/setup-deps")
  endif()
  add_library(vek_vorbis INTERFACE)
  target_include_directories(vek_vorbis INTERFACE ${VEK_MINGW_DEPS}/include)
  target_link_libraries(vek_vorbis INTERFACE
    ${VEK_MINGW_DEPS}/lib/libvorbisfile.a ${VEK_MINGW_DEPS}/lib/libvorbisenc.a
    ${VEK_MINGW_DEPS}/lib/libvorbis.a ${VEK_MINGW_DEPS}/lib/libogg.a)
else()
  find_package(PkgConfig REQUIRED)
  pkg_check_modules(VORBIS REQUIRED IMPORTED_TARGET vorbisfile vorbisenc vorbis ogg)
  add_library(vek_vorbis INTERFACE)
  target_link_libraries(vek_vorbis INTERFACE PkgConfig::VORBIS)
endif()

# libebur128 (loudness): Debian's natively; for Windows the static library
# that tools/setup-deps builds from Debian's source package into .deps/mingw.
if(WIN32)
  if(NOT EXISTS ${VEK_MINGW_DEPS}/lib/libebur128.a)
    message(FATAL_ERROR "libebur128 for MinGW is missing under ${VEK_MINGW_DEPS}: run tools/setup-deps")
  endif()
  add_library(vek_ebur128 INTERFACE)
  target_include_directories(vek_ebur128 INTERFACE ${VEK_MINGW_DEPS}/include)
  target_link_libraries(vek_ebur128 INTERFACE ${VEK_MINGW_DEPS}/lib/libebur128.a)
else()
  pkg_check_modules(EBUR128 REQUIRED IMPORTED_TARGET libebur128)
  add_library(vek_ebur128 INTERFACE)
  target_link_libraries(vek_ebur128 INTERFACE PkgConfig::EBUR128)
endif()

# nlohmann-json (header-only): Debian's natively; for the MinGW cross build a
# copy of those headers in a folder of their own (tools/setup-deps puts it in
# .deps/json), so the host's include folder never reaches the cross
# compiler; on Windows itself, the toolchain's own package.
add_library(vek_json INTERFACE)
if(WIN32)
  set(VEK_JSON_INCLUDE ${PROJECT_SOURCE_DIR}/.deps/json/include CACHE PATH "Folder holding nlohmann/json.hpp")
  if(EXISTS ${VEK_JSON_INCLUDE}/nlohmann/json.hpp)
    target_include_directories(vek_json SYSTEM INTERFACE ${VEK_JSON_INCLUDE})
  endif()
else()
  find_package(nlohmann_json 3.11 REQUIRED)
  target_link_libraries(vek_json INTERFACE nlohmann_json::nlohmann_json)
endif()
