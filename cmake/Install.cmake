# Install rules, the CMake package Configuration::Configuration, the pkg-config file, the systemd
# unit, the man pages and the Debian packages (CPack). Included last from the top-level list.
#
# Layout (GNUInstallDirs): the shared libraries in LIBDIR (libServerInterop.so beside
# libConfiguration.so, where the library looks for it at load time), every public header under
# INCLUDEDIR/quorvex, configctl in BINDIR, configuration-service in SBINDIR, docs and examples in
# DOCDIR. Components: "runtime" (the libraries), "dev" (headers, CMake package, pkg-config),
# "service" (the service, configctl, the unit, the man pages).

include(GNUInstallDirs)
include(CMakePackageConfigHelpers)

set(QUORVEX_INCLUDE_PREFIX ${CMAKE_INSTALL_INCLUDEDIR}/quorvex)
set(QUORVEX_CMAKE_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/Configuration)

# In-tree users (add_subdirectory) link the same name as users of the installed package.
add_library(Configuration::Configuration ALIAS Configuration)

foreach(target Configuration Vesk QuorvexCommon)
  target_include_directories(${target} INTERFACE $<INSTALL_INTERFACE:${QUORVEX_INCLUDE_PREFIX}>)
endforeach()

# Outside /usr the installed libraries and programs find each other relative to themselves, so
# that a prefix works without ldconfig; under /usr (the package) the linker's paths do.
if(NOT CMAKE_INSTALL_PREFIX STREQUAL "/usr")
  set_target_properties(Configuration Vesk QuorvexCommon ServerInterop PROPERTIES
                        INSTALL_RPATH "$ORIGIN")
  file(RELATIVE_PATH relative /${CMAKE_INSTALL_BINDIR} /${CMAKE_INSTALL_LIBDIR})
  set_target_properties(configctl PROPERTIES INSTALL_RPATH "$ORIGIN/${relative}")
  file(RELATIVE_PATH relative /${CMAKE_INSTALL_SBINDIR} /${CMAKE_INSTALL_LIBDIR})
  set_target_properties(configuration-service PROPERTIES INSTALL_RPATH "$ORIGIN/${relative}")
endif()

install(TARGETS Configuration Vesk QuorvexCommon EXPORT ConfigurationTargets
        LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT runtime
                NAMELINK_COMPONENT dev)
# Loaded by name with dlopen, never linked by consumers: no SONAME link, runtime component.
install(TARGETS ServerInterop LIBRARY DESTINATION ${CMAKE_INSTALL_LIBDIR} COMPONENT runtime)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/include/ DESTINATION ${QUORVEX_INCLUDE_PREFIX}
        COMPONENT dev FILES_MATCHING PATTERN "*.h")

install(TARGETS configctl RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR} COMPONENT service)
install(TARGETS configuration-service RUNTIME DESTINATION ${CMAKE_INSTALL_SBINDIR}
        COMPONENT service)

install(FILES ${PROJECT_SOURCE_DIR}/README.md DESTINATION ${CMAKE_INSTALL_DOCDIR} COMPONENT dev)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/docs/ DESTINATION ${CMAKE_INSTALL_DOCDIR} COMPONENT dev)
install(DIRECTORY ${PROJECT_SOURCE_DIR}/examples/ DESTINATION ${CMAKE_INSTALL_DOCDIR}/examples
        COMPONENT dev PATTERN "CMakeLists.txt" EXCLUDE)

# The CMake package: find_package(Configuration CONFIG) gives Configuration::Configuration.
install(EXPORT ConfigurationTargets NAMESPACE Configuration:: DESTINATION ${QUORVEX_CMAKE_DIR}
        COMPONENT dev)
configure_package_config_file(${PROJECT_SOURCE_DIR}/packaging/ConfigurationConfig.cmake.in
                              ${PROJECT_BINARY_DIR}/ConfigurationConfig.cmake
                              INSTALL_DESTINATION ${QUORVEX_CMAKE_DIR})
write_basic_package_version_file(${PROJECT_BINARY_DIR}/ConfigurationConfigVersion.cmake
                                 COMPATIBILITY SameMajorVersion)
install(FILES ${PROJECT_BINARY_DIR}/ConfigurationConfig.cmake
              ${PROJECT_BINARY_DIR}/ConfigurationConfigVersion.cmake
        DESTINATION ${QUORVEX_CMAKE_DIR} COMPONENT dev)

# The pkg-config file: absolute under /usr (the package), elsewhere relocatable through ${pcfiledir}.
if(CMAKE_INSTALL_PREFIX STREQUAL "/usr")
  set(QUORVEX_PC_PREFIX /usr)
else()
  file(RELATIVE_PATH relative /${CMAKE_INSTALL_LIBDIR}/pkgconfig /)
  string(REGEX REPLACE "/$" "" relative "${relative}")
  set(QUORVEX_PC_PREFIX "\${pcfiledir}/${relative}")
endif()
configure_file(${PROJECT_SOURCE_DIR}/packaging/configuration.pc.in
               ${PROJECT_BINARY_DIR}/configuration.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/configuration.pc
        DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig COMPONENT dev)

include(${CMAKE_CURRENT_LIST_DIR}/Service.cmake OPTIONAL)
include(${CMAKE_CURRENT_LIST_DIR}/Package.cmake OPTIONAL)
