# Configures the Android presets of SOURCE below WORK: without an NDK, with what is none or too old,
# and with a stand-in that notes what it is given.
file(REMOVE_RECURSE ${WORK})

# configure(PRESET NDK): with ANDROID_NDK_HOME set to NDK, or unset where that is empty. Every
# configuration here has to fail; what it prints is left in `output`.
function(configure preset ndk)
  set(setting --unset=ANDROID_NDK_HOME)
  if(ndk)
    set(setting ANDROID_NDK_HOME=${ndk})
  endif()
  file(REMOVE_RECURSE ${WORK}/build)
  execute_process(COMMAND ${CMAKE_COMMAND} -E env ${setting}
                          ${CMAKE_COMMAND} --preset ${preset} -B ${WORK}/build
                  WORKING_DIRECTORY ${SOURCE}
                  OUTPUT_VARIABLE output ERROR_VARIABLE output RESULT_VARIABLE result)
  if(result EQUAL 0)
    message(FATAL_ERROR "${preset} was configured with ANDROID_NDK_HOME '${ndk}':\n${output}")
  endif()
  set(output "${output}" PARENT_SCOPE)
endfunction()

# expect_line(FAULT): one line names the fault and how to mend it.
function(expect_line fault)
  set(line "\n *${fault}: install an Android NDK r23 or later [^\n]* set ANDROID_NDK_HOME [^\n]*\n")
  if(NOT output MATCHES "${line}")
    message(FATAL_ERROR "no line '${fault}: ...' in:\n${output}")
  endif()
  string(REGEX MATCHALL "CMake Error" errors "${output}")
  list(LENGTH errors count)
  if(NOT count EQUAL 1)
    message(FATAL_ERROR "more than one error:\n${output}")
  endif()
endfunction()

# make_ndk(FOLDER REVISION): a folder that passes for an NDK. Its toolchain writes down what it is
# given, and stops.
function(make_ndk folder revision)
  file(WRITE ${folder}/source.properties "Pkg.Desc = Android NDK\nPkg.Revision = ${revision}\n")
  file(WRITE ${folder}/build/cmake/android.toolchain.cmake [[
foreach(name IN ITEMS ANDROID_ABI ANDROID_PLATFORM ANDROID_STL ANDROID_ARM_NEON CMAKE_BUILD_TYPE
        DRAVENTA_TESTS DRAVENTA_JAVA)
  message(NOTICE "given ${name}=${${name}}")
endforeach()
message(FATAL_ERROR " the stand-in stops here")
]])
endfunction()

# expect_given(PRESET ABI NEON)
function(expect_given preset abi neon)
  configure(${preset} ${WORK}/ndk)
  set(expected "given ANDROID_ABI=${abi}" "given ANDROID_PLATFORM=android-21"
      "given ANDROID_STL=c++_static" "given ANDROID_ARM_NEON=${neon}"
      "given CMAKE_BUILD_TYPE=Release" "given DRAVENTA_TESTS=OFF" "given DRAVENTA_JAVA=OFF")
  string(REGEX MATCHALL "given [^\n]*" given "${output}")
  if(NOT given STREQUAL expected)
    message(FATAL_ERROR "${preset} gave the NDK\n${given}\nnot\n${expected}")
  endif()
  if(NOT output MATCHES "the stand-in stops here")
    message(FATAL_ERROR "${preset} stopped elsewhere:\n${output}")
  endif()
endfunction()

foreach(preset IN ITEMS android-arm64-v8a android-armeabi-v7a android-x86_64)
  configure(${preset} "")
  expect_line("ANDROID_NDK_HOME is not set")
endforeach()

file(MAKE_DIRECTORY ${WORK}/empty)
configure(android-arm64-v8a ${WORK}/empty)
expect_line("${WORK}/empty is no Android NDK")

make_ndk(${WORK}/old 22.1.7171670)
configure(android-arm64-v8a ${WORK}/old)
expect_line("the Android NDK in ${WORK}/old is of release '22'")

make_ndk(${WORK}/odd "")
configure(android-arm64-v8a ${WORK}/odd)
expect_line("the Android NDK in ${WORK}/odd is of release ''")

make_ndk(${WORK}/ndk 23.0.7599858)
expect_given(android-arm64-v8a arm64-v8a "")
expect_given(android-armeabi-v7a armeabi-v7a ON)
expect_given(android-x86_64 x86_64 "")
