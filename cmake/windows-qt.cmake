# Toolchain of the windows preset.
# On Windows itself: a native build with the developer's own compiler (MinGW-w64) and Qt, found
# through CMAKE_PREFIX_PATH or KICKVANE_QT_WINDOWS_DIR.
# Elsewhere: a cross-build with MinGW-w64 against a static Qt for Windows, taken from
# KICKVANE_QT_WINDOWS_DIR or from the cache that scripts/build-qt-windows.sh fills.
if(DEFINED ENV{KICKVANE_QT_WINDOWS_DIR} AND NOT "$ENV{KICKVANE_QT_WINDOWS_DIR}" STREQUAL "")
  set(kickvane_qt_dir "$ENV{KICKVANE_QT_WINDOWS_DIR}")
elseif(DEFINED ENV{XDG_CACHE_HOME} AND NOT "$ENV{XDG_CACHE_HOME}" STREQUAL "")
  set(kickvane_qt_dir "$ENV{XDG_CACHE_HOME}/kickvane/qt-6.4.2-mingw-w64")
else()
  set(kickvane_qt_dir "$ENV{HOME}/.cache/kickvane/qt-6.4.2-mingw-w64")
endif()

if(CMAKE_HOST_WIN32)
  if(DEFINED ENV{KICKVANE_QT_WINDOWS_DIR})
    list(APPEND CMAKE_PREFIX_PATH "${kickvane_qt_dir}")
  endif()
  return()
endif()

if(NOT EXISTS "${kickvane_qt_dir}/lib/cmake/Qt6/qt.toolchain.cmake")
  message(FATAL_ERROR "No Qt for Windows in ${kickvane_qt_dir}: run scripts/build-qt-windows.sh "
                      "or set KICKVANE_QT_WINDOWS_DIR")
endif()
set(QT_CHAINLOAD_TOOLCHAIN_FILE "${CMAKE_CURRENT_LIST_DIR}/mingw-w64.cmake")
include("${kickvane_qt_dir}/lib/cmake/Qt6/qt.toolchain.cmake")
set(CMAKE_CROSSCOMPILING_EMULATOR wine)
