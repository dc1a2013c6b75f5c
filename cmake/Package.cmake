# Defines the targets that an application links, in this build and from an installed package: Tidemark::effect, the
# library, and Tidemark::host, the host in C++ above it.
include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

set(headers ${CMAKE_INSTALL_INCLUDEDIR}/tidemark)
set(stand_ins ${CMAKE_INSTALL_LIBDIR}/tidemark)  # their names are too general for the folder of all libraries
set(config ${CMAKE_INSTALL_LIBDIR}/cmake/Tidemark)

add_library(tidemark_host_package INTERFACE)
target_link_libraries(tidemark_host_package INTERFACE tidemark_host TidemarkEffect)
target_compile_features(tidemark_host_package INTERFACE cxx_std_20)
add_library(Tidemark::host ALIAS tidemark_host_package)

set_target_properties(TidemarkEffect PROPERTIES
    VERSION ${PROJECT_VERSION} SOVERSION ${PROJECT_VERSION_MAJOR} INSTALL_RPATH $ORIGIN/tidemark EXPORT_NAME effect)
set_target_properties(tidemark_host_package PROPERTIES EXPORT_NAME host)
install(TARGETS TidemarkEffect tidemark_host tidemark_host_package EXPORT Tidemark INCLUDES DESTINATION ${headers})
install(TARGETS tidemark_log tidemark_jnigraphics EXPORT Tidemark LIBRARY DESTINATION ${stand_ins})
install(FILES jni/natives.h DESTINATION ${headers}/jni)
install(DIRECTORY host ${PROJECT_BINARY_DIR}/generated/host DESTINATION ${headers} FILES_MATCHING PATTERN *.h
    PATTERN engine_window.h EXCLUDE PATTERN log_filter.h EXCLUDE)
install(DIRECTORY platform/include/ DESTINATION ${headers})
install(FILES platform/desktop_bitmap.h DESTINATION ${headers}/platform)

install(EXPORT Tidemark NAMESPACE Tidemark:: FILE TidemarkConfig.cmake DESTINATION ${config})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/TidemarkConfigVersion.cmake COMPATIBILITY SameMajorVersion)
file(RELATIVE_PATH up /prefix/${CMAKE_INSTALL_LIBDIR}/pkgconfig /prefix)
configure_file(cmake/tidemark.pc.in ${PROJECT_BINARY_DIR}/tidemark.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/TidemarkConfigVersion.cmake DESTINATION ${config})
install(FILES ${PROJECT_BINARY_DIR}/tidemark.pc DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig)
