# Installs BUILD, compares what is there with what should be, and moves it to PREFIX.
file(REMOVE_RECURSE ${WORK})
execute_process(COMMAND ${CMAKE_COMMAND} --install ${BUILD} --prefix ${WORK}/first
                OUTPUT_QUIET COMMAND_ERROR_IS_FATAL ANY)

set(config ${LIBDIR}/cmake/draventaUtil/draventaUtilConfig)
set(expected ${LIBDIR}/libdraventaUtil.so ${LIBDIR}/pkgconfig/draventaUtil.pc
    ${config}.cmake ${config}-release.cmake ${config}Version.cmake)
foreach(header IN LISTS HEADERS)
  list(APPEND expected ${INCLUDEDIR}/draventaUtil/${header})
endforeach()

file(GLOB_RECURSE installed RELATIVE ${WORK}/first ${WORK}/first/*)
set(extra ${installed})
list(REMOVE_ITEM extra ${expected})
set(missing ${expected})
list(REMOVE_ITEM missing ${installed})
if(extra OR missing)
  message(FATAL_ERROR "installed but not meant to be: ${extra}\nnot installed: ${missing}")
endif()
file(RENAME ${WORK}/first ${PREFIX})
