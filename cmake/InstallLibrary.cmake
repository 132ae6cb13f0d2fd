# What `cmake --install` puts down: the library, its headers in their folders, and how CMake's
# find_package(draventaUtil) and pkg-config find them. The installed folder may be moved.
#
# DRAVENTA_HEADERS lists the headers; those of DRAVENTA_CXX_HEADERS are for C++ alone.
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

set(DRAVENTA_CXX_HEADERS selection/D_Queue.h selection/ER_selection.h)
set(DRAVENTA_HEADERS
  draventaUtil.h
  render/compositing.h
  render/mask_transfer.h
  selection/objectsel.h
  selection/region_shaping.h
  selection/ze_rect.h
  support/fixed_point.h
  support/ze_alloc.h
  support/ze_api.h
  ${DRAVENTA_CXX_HEADERS})

# The headers include each other from one root, which the target brings.
target_sources(draventaUtil PUBLIC FILE_SET HEADERS BASE_DIRS ${PROJECT_SOURCE_DIR}
               FILES ${DRAVENTA_HEADERS})
add_library(draventaUtil::draventaUtil ALIAS draventaUtil)  # the same name without installing

# The Android log has a folder of its own on Debian, where the loader does not look by itself.
if(NOT ANDROID)
  set_target_properties(draventaUtil PROPERTIES INSTALL_RPATH_USE_LINK_PATH ON)
endif()

set(cmake_folder ${CMAKE_INSTALL_LIBDIR}/cmake/draventaUtil)
set(pkgconfig_folder ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
set(header_folder ${CMAKE_INSTALL_INCLUDEDIR}/draventaUtil)

install(TARGETS draventaUtil EXPORT draventaUtil
        LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT library
        FILE_SET HEADERS DESTINATION ${header_folder} COMPONENT headers
        INCLUDES DESTINATION ${header_folder})
install(EXPORT draventaUtil NAMESPACE draventaUtil:: FILE draventaUtilConfig.cmake
        DESTINATION ${cmake_folder} COMPONENT headers)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/draventaUtilConfigVersion.cmake
                                 COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/draventaUtilConfigVersion.cmake
        DESTINATION ${cmake_folder} COMPONENT headers)

# From the .pc file to the folder that everything lies in, as pkg-config works it out when asked.
cmake_path(SET pc_folder NORMALIZE ${CMAKE_INSTALL_PREFIX}/${pkgconfig_folder})
cmake_path(RELATIVE_PATH CMAKE_INSTALL_PREFIX BASE_DIRECTORY ${pc_folder}
           OUTPUT_VARIABLE pc_to_prefix)
configure_file(cmake/draventaUtil.pc.in draventaUtil.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/draventaUtil.pc
        DESTINATION ${pkgconfig_folder} COMPONENT headers)
