# Debian packages by CPack, one per component: libconfiguration0 (the shared libraries),
# libconfiguration-dev (headers, CMake package, pkg-config, docs and examples) and
# configuration-service (the service, configctl, the unit, the man pages). Build them from a tree
# configured with -DCMAKE_INSTALL_PREFIX=/usr (scripts/package-test.sh does).
#
# Lintian tags that remain, and why:
#   bogus-mail-host(-in-debian-changelog)  the placeholder QUORVEX_PACKAGE_CONTACT; a release sets it
#   copyright-without-copyright-notice     packaging/deb/copyright names no holder yet
#   initial-upload-closes-no-bugs          packages for our own sites, no Debian bug to close
#   maintscript-calls-ldconfig             CPack writes the ldconfig calls itself; the ldconfig
#                                          trigger (packaging/deb/triggers) is there as well
#   shared-library-lacks-version           libServerInterop.so is a module loaded by that exact
#                                          name with dlopen, never linked

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME configuration)
set(CPACK_PACKAGE_VENDOR "Configuration developers")
# The maintainer named in the packages; set it to the team's address when releasing.
set(QUORVEX_PACKAGE_CONTACT "Configuration developers <configuration@localhost>"
    CACHE STRING "Maintainer field of the Debian packages")
set(CPACK_PACKAGE_CONTACT "${QUORVEX_PACKAGE_CONTACT}")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "configuration library and service of a DICOM archive")
set(CPACK_PACKAGING_INSTALL_PREFIX ${CMAKE_INSTALL_PREFIX})
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_COMPONENTS_ALL runtime dev service)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_RELEASE 1)
set(CPACK_STRIP_FILES ON)
set(QUORVEX_DEB_VERSION ${PROJECT_VERSION}-${CPACK_DEBIAN_PACKAGE_RELEASE})
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)
# The programs need the package's own libraries; dpkg-shlibdeps finds them in the build tree and
# the dependency on libconfiguration0 is written out below.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${PROJECT_BINARY_DIR}/platform
                                                ${PROJECT_BINARY_DIR}/configuration)
set(CPACK_DEBIAN_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_PACKAGE_HOMEPAGE "https://localhost/configuration")

set(CPACK_DEBIAN_RUNTIME_PACKAGE_NAME libconfiguration0)
set(CPACK_DEBIAN_RUNTIME_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_RUNTIME_DESCRIPTION
    "configuration library of a DICOM archive\n The shared libraries every server process of the archive links to read and\n write its typed configuration, and the service-ticket module.")
set(CPACK_DEBIAN_DEV_PACKAGE_NAME libconfiguration-dev)
set(CPACK_DEBIAN_DEV_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEV_PACKAGE_DEPENDS "libconfiguration0 (= ${QUORVEX_DEB_VERSION}), libace-dev")
set(CPACK_DEBIAN_DEV_DESCRIPTION
    "configuration library of a DICOM archive - development files\n Public headers, the CMake package Configuration::Configuration, the\n pkg-config file, documentation and examples.")
set(CPACK_DEBIAN_SERVICE_PACKAGE_NAME configuration-service)
set(CPACK_DEBIAN_SERVICE_PACKAGE_SECTION admin)
set(CPACK_DEBIAN_SERVICE_PACKAGE_DEPENDS "libconfiguration0 (= ${QUORVEX_DEB_VERSION}), adduser")
set(CPACK_DEBIAN_SERVICE_DESCRIPTION
    "configuration service of a DICOM archive and its tool\n The per-machine configuration web service (systemd unit\n configuration-service.service) and configctl, the administrators' tool.")
set(CPACK_DEBIAN_RUNTIME_PACKAGE_CONTROL_EXTRA ${PROJECT_SOURCE_DIR}/packaging/deb/triggers)
set(CPACK_DEBIAN_SERVICE_PACKAGE_CONTROL_EXTRA
    ${PROJECT_SOURCE_DIR}/packaging/deb/conffiles ${PROJECT_SOURCE_DIR}/packaging/deb/postinst ${PROJECT_SOURCE_DIR}/packaging/deb/prerm
    ${PROJECT_SOURCE_DIR}/packaging/deb/postrm)
set(CPACK_DEBIAN_SERVICE_PACKAGE_CONTROL_STRICT_PERMISSION ON)

# Each package's copyright and Debian changelog in /usr/share/doc/<package>.
string(TIMESTAMP QUORVEX_CHANGELOG_DATE "%a, %d %b %Y %H:%M:%S +0000" UTC)
file(WRITE ${PROJECT_BINARY_DIR}/deb/changelog.Debian
     "configuration (${QUORVEX_DEB_VERSION}) unstable; urgency=medium\n\n"
     "  * Built from the project's sources.\n\n"
     " -- ${CPACK_PACKAGE_CONTACT}  ${QUORVEX_CHANGELOG_DATE}\n")
execute_process(COMMAND gzip -9nf ${PROJECT_BINARY_DIR}/deb/changelog.Debian)
foreach(entry "runtime;libconfiguration0" "dev;libconfiguration-dev" "service;configuration-service")
  list(GET entry 0 component)
  list(GET entry 1 package)
  install(FILES ${PROJECT_SOURCE_DIR}/packaging/deb/copyright
                ${PROJECT_BINARY_DIR}/deb/changelog.Debian.gz
          DESTINATION ${CMAKE_INSTALL_DATAROOTDIR}/doc/${package} COMPONENT ${component})
endforeach()
include(CPack)
