# Target `stripped`: package/libdraventaUtil.so as an app ships it, and its symbols beside it in
# package/libdraventaUtil.so.debug, which debuggers find by the build-id or by name.
set(package ${PROJECT_BINARY_DIR}/package)
set(library ${package}/libdraventaUtil.so)
add_custom_command(OUTPUT ${library} ${library}.debug
  COMMAND ${CMAKE_COMMAND} -E make_directory ${package}
  COMMAND ${CMAKE_OBJCOPY} --only-keep-debug $<TARGET_FILE:draventaUtil> ${library}.debug
  COMMAND ${CMAKE_OBJCOPY} --strip-unneeded --add-gnu-debuglink=${library}.debug
          $<TARGET_FILE:draventaUtil> ${library}
  DEPENDS draventaUtil
  COMMENT "Stripping ${library}"
  VERBATIM)
if(ANDROID)  # elsewhere when asked for
  set(always ALL)
endif()
add_custom_target(stripped ${always} DEPENDS ${library} ${library}.debug)
