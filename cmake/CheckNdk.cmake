# Stops unless CMAKE_TOOLCHAIN_FILE is that of an Android NDK which is new enough. To be included
# before project(), which goes on after a missing toolchain and reports what follows from it.
cmake_path(SET ndk NORMALIZE "${CMAKE_TOOLCHAIN_FILE}/../../..")
string(REGEX REPLACE "/$" "" ndk "${ndk}")
set(fault "")
if(ndk STREQUAL "")  # the presets build the path from the variable
  set(fault "ANDROID_NDK_HOME is not set")
elseif(NOT EXISTS "${CMAKE_TOOLCHAIN_FILE}" OR NOT EXISTS "${ndk}/source.properties")
  set(fault "${ndk} is no Android NDK")
else()
  file(STRINGS "${ndk}/source.properties" revision REGEX "^Pkg.Revision *=")
  string(REGEX MATCH "[0-9]+" revision "${revision}")
  if(NOT revision GREATER_EQUAL 23)
    set(fault "the Android NDK in ${ndk} is of release '${revision}'")
  endif()
endif()
if(fault)  # the blank in front keeps it one line
  string(CONCAT mend
    "install an Android NDK r23 or later (Android Studio: SDK Manager, SDK Tools, NDK) and set "
    "ANDROID_NDK_HOME to its folder, such as ~/Android/Sdk/ndk/VERSION")
  message(FATAL_ERROR " ${fault}: ${mend}")
endif()
