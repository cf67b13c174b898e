# What an installed library consists of: headers, library, CMake package, pkg-config module and schema.
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

set(package_dir ${CMAKE_INSTALL_LIBDIR}/cmake/hqf)

install(TARGETS hqf EXPORT hqfTargets LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR})

# Users see every header but the engine's, of which the model classes include three. Should they come to include a
# fourth, the install test tells: it compiles all installed headers.
foreach(root ${PROJECT_SOURCE_DIR}/hqf ${PROJECT_BINARY_DIR}/generated/hqf)
  install(DIRECTORY ${root} DESTINATION ${CMAKE_INSTALL_INCLUDEDIR} FILES_MATCHING PATTERN "*.h"
          PATTERN frame EXCLUDE
          PATTERN generator EXCLUDE
          REGEX "/model/tables\\.h$" EXCLUDE
          # of the flat layer users see hqf_flat.h alone
          REGEX "/flat/(additions|conventions|platform_strings)\\.h$" EXCLUDE)
endforeach()
install(FILES ${PROJECT_SOURCE_DIR}/hqf/frame/storage.h ${PROJECT_SOURCE_DIR}/hqf/frame/list.h
              ${PROJECT_SOURCE_DIR}/hqf/frame/pool.h
        DESTINATION ${CMAKE_INSTALL_INCLUDEDIR}/hqf/frame)

install(EXPORT hqfTargets NAMESPACE hqf:: DESTINATION ${package_dir})
configure_package_config_file(${CMAKE_CURRENT_LIST_DIR}/hqfConfig.cmake.in ${PROJECT_BINARY_DIR}/hqfConfig.cmake
                              INSTALL_DESTINATION ${package_dir})
# Before 1.0 a minor version may break callers.
write_basic_package_version_file(${PROJECT_BINARY_DIR}/hqfConfigVersion.cmake COMPATIBILITY SameMinorVersion)
install(FILES ${PROJECT_BINARY_DIR}/hqfConfig.cmake ${PROJECT_BINARY_DIR}/hqfConfigVersion.cmake
        DESTINATION ${package_dir})

# The prefix is told from the place of hqf.pc, so that an installed tree can be moved.
file(RELATIVE_PATH prefix_from_pc /${CMAKE_INSTALL_LIBDIR}/pkgconfig /)
string(REGEX REPLACE "/$" "" prefix_from_pc ${prefix_from_pc})
configure_file(${CMAKE_CURRENT_LIST_DIR}/hqf.pc.in ${PROJECT_BINARY_DIR}/hqf.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/hqf.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)

install(FILES ${PROJECT_SOURCE_DIR}/hqf/model/hqf-v2.xsd DESTINATION ${CMAKE_INSTALL_DATADIR}/hqf)
install(FILES ${PROJECT_BINARY_DIR}/generated/docs/vocabulary.md DESTINATION ${CMAKE_INSTALL_DOCDIR})

if(BUILD_TESTING)
  add_subdirectory(${PROJECT_SOURCE_DIR}/tests/install)
endif()
