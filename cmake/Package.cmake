# Debian packages by CPack, one per component: libconfiguration0 (the shared libraries),
# libconfiguration-dev (headers, CMake package, pkg-config, docs and examples) and
# configuration-service (the service, configctl, the unit, the man pages). Build them from a tree
# configured with -DCMAKE_INSTALL_PREFIX=/usr (scripts/package-test.sh does).
#
# The maintainer (QUORVEX_PACKAGE_CONTACT), the lintian tags that remain and why: see
# docs/PACKAGING.md.

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME configuration)
set(CPACK_PACKAGE_VENDOR "Quorvex Configuration Team")
# The maintainer named in the packages and their changelog; a site that rebuilds the packages
# sets its own.
set(QUORVEX_PACKAGE_CONTACT "Quorvex Configuration Team <configuration@quorvex.example>"
    CACHE STRING "Maintainer field of the Debian packages (Name <address>)")
# Trees configured before the team's address was set hold a placeholder lintian rejects.
if(QUORVEX_PACKAGE_CONTACT MATCHES "@localhost>$")
  set_property(CACHE QUORVEX_PACKAGE_CONTACT
               PROPERTY VALUE "Quorvex Configuration Team <configuration@quorvex.example>")
endif()
set(CPACK_PACKAGE_CONTACT "${QUORVEX_PACKAGE_CONTACT}")
# No CPACK_PACKAGE_DESCRIPTION_SUMMARY: CPack would put it before each package's own synopsis.
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
set(CPACK_DEBIAN_PACKAGE_HOMEPAGE "https://quorvex.example/configuration")

set(CPACK_DEBIAN_RUNTIME_PACKAGE_NAME libconfiguration0)
set(CPACK_DEBIAN_RUNTIME_PACKAGE_SECTION libs)
set(CPACK_DEBIAN_RUNTIME_DESCRIPTION
    "configuration library of a DICOM archive\nThe shared libraries every server process of the archive links to read and\nwrite its typed configuration, and the service-ticket module.")
set(CPACK_DEBIAN_DEV_PACKAGE_NAME libconfiguration-dev)
set(CPACK_DEBIAN_DEV_PACKAGE_SECTION libdevel)
set(CPACK_DEBIAN_DEV_PACKAGE_DEPENDS "libconfiguration0 (= ${QUORVEX_DEB_VERSION}), libace-dev")
set(CPACK_DEBIAN_DEV_DESCRIPTION
    "configuration library of a DICOM archive - development files\nPublic headers, the CMake package Configuration::Configuration, the\npkg-config file, documentation and examples.")
set(CPACK_DEBIAN_SERVICE_PACKAGE_NAME configuration-service)
set(CPACK_DEBIAN_SERVICE_PACKAGE_SECTION admin)
set(CPACK_DEBIAN_SERVICE_PACKAGE_DEPENDS "libconfiguration0 (= ${QUORVEX_DEB_VERSION}), adduser")
set(CPACK_DEBIAN_SERVICE_DESCRIPTION
    "configuration service of a DICOM archive and its tool\nThe per-machine configuration web service (systemd unit\nconfiguration-service.service) and configctl, the administrators' tool.")
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
