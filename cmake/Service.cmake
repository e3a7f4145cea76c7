# The systemd unit, its system user, and the man pages generated from the programs' --help.

configure_file(${PROJECT_SOURCE_DIR}/packaging/configuration-service.service.in
               ${PROJECT_BINARY_DIR}/configuration-service.service @ONLY)
# Under /usr (the package) the unit and the defaults go where Debian keeps them; elsewhere inside
# the prefix.
if(CMAKE_INSTALL_PREFIX STREQUAL "/usr")
  set(QUORVEX_UNIT_DIR /lib/systemd/system)
  set(QUORVEX_DEFAULTS_DIR /etc/default)
else()
  set(QUORVEX_UNIT_DIR lib/systemd/system)
  set(QUORVEX_DEFAULTS_DIR ${CMAKE_INSTALL_SYSCONFDIR}/default)
endif()
install(FILES ${PROJECT_BINARY_DIR}/configuration-service.service
        DESTINATION ${QUORVEX_UNIT_DIR} COMPONENT service)
install(FILES ${PROJECT_SOURCE_DIR}/packaging/quorvex-configuration.sysusers
        DESTINATION lib/sysusers.d RENAME quorvex-configuration.conf COMPONENT service)
install(FILES ${PROJECT_SOURCE_DIR}/packaging/configuration-service.default
        DESTINATION ${QUORVEX_DEFAULTS_DIR} RENAME configuration-service COMPONENT service)

# Man pages: help2man over each program's --help, with the sections --help lacks from
# packaging/*.h2m. Built with the programs, except in the instrumented builds.
find_program(HELP2MAN help2man)
if(HELP2MAN AND NOT QUORVEX_SANITIZE AND NOT QUORVEX_TSAN AND NOT QUORVEX_FUZZ)
  set(pages)
  foreach(entry "configctl;1;administer a configuration service"
                "configuration-service;8;this machine's configuration service")
    list(GET entry 0 program)
    list(GET entry 1 section)
    list(GET entry 2 summary)
    set(page ${PROJECT_BINARY_DIR}/man/${program}.${section})
    add_custom_command(
      OUTPUT ${page}.gz
      COMMAND ${CMAKE_COMMAND} -E make_directory ${PROJECT_BINARY_DIR}/man
      COMMAND ${HELP2MAN} --no-info --no-discard-stderr --section=${section} --name=${summary}
              --version-string=${PROJECT_VERSION}
              --include=${PROJECT_SOURCE_DIR}/packaging/${program}.h2m --output=${page}
              $<TARGET_FILE:${program}>
      COMMAND gzip -9nf ${page}
      DEPENDS ${program} ${PROJECT_SOURCE_DIR}/packaging/${program}.h2m
      COMMENT "Man page ${program}(${section})" VERBATIM)
    list(APPEND pages ${page}.gz)
    install(FILES ${page}.gz DESTINATION ${CMAKE_INSTALL_MANDIR}/man${section} COMPONENT service)
  endforeach()
  add_custom_target(man-pages ALL DEPENDS ${pages})
endif()
