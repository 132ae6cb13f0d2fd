# Builds SOURCE as C99 with the flags that pkg-config gives for the library in PREFIX, and runs it.
find_program(pkg_config pkg-config)
if(NOT pkg_config)
  message(FATAL_ERROR " pkg-config is missing: install the package pkgconf")
endif()
find_program(cc NAMES cc gcc clang REQUIRED)
set(ENV{PKG_CONFIG_LIBDIR} ${PREFIX}/${LIBDIR}/pkgconfig)  # these packages and no other

execute_process(COMMAND ${pkg_config} --modversion draventaUtil
                OUTPUT_VARIABLE version OUTPUT_STRIP_TRAILING_WHITESPACE COMMAND_ERROR_IS_FATAL ANY)
if(NOT version STREQUAL VERSION)
  message(FATAL_ERROR "pkg-config has version ${version}, CMake has ${VERSION}")
endif()

execute_process(COMMAND ${pkg_config} --cflags --libs draventaUtil
                OUTPUT_VARIABLE flags COMMAND_ERROR_IS_FATAL ANY)
separate_arguments(flags UNIX_COMMAND "${flags}")
execute_process(COMMAND ${cc} -std=c99 -pedantic -Wall -Wextra -Werror ${SOURCE} ${flags}
                        -o ${PROGRAM}
                COMMAND_ERROR_IS_FATAL ANY)
set(ENV{LD_LIBRARY_PATH} ${PREFIX}/${LIBDIR})
execute_process(COMMAND ${PROGRAM} COMMAND_ERROR_IS_FATAL ANY)
