# What is installed beside programs and libraries, and the Debian packages qm-rps (command line, help,
# examples, guide) and qm-rps-desktop: cpack --config build/release/CPackConfig.cmake

set(share ${CMAKE_INSTALL_DATADIR})
set(packaging ${PROJECT_SOURCE_DIR}/packaging)

set(CPACK_PACKAGE_CONTACT "qm_rps maintainers <maintainers@qm-rps.invalid>")
set(CPACK_DEBIAN_PACKAGE_RELEASE 1)
configure_file(${packaging}/changelog.Debian.in ${PROJECT_BINARY_DIR}/changelog.Debian @ONLY)

# The program writes its manual pages and completions, so they say what --help says.
set(help ${PROJECT_BINARY_DIR}/help)
set(pages)
if(QM_UI)
  set(pages ${packaging}/qm-rps-desktop.1)
endif()
add_custom_command(
  OUTPUT ${help}.stamp
  COMMAND ${CMAKE_COMMAND} -DPROGRAM=$<TARGET_FILE:qm-rps> -DFOLDER=${help} -DPAGES=${pages}
          -DCHANGES=${PROJECT_SOURCE_DIR}/CHANGELOG.md
          -DDEBIAN_CHANGES=${PROJECT_BINARY_DIR}/changelog.Debian
          -P ${PROJECT_SOURCE_DIR}/cmake/writehelp.cmake
  COMMAND ${CMAKE_COMMAND} -E touch ${help}.stamp
  DEPENDS qm-rps ${pages} ${PROJECT_SOURCE_DIR}/cmake/writehelp.cmake
          ${PROJECT_SOURCE_DIR}/CHANGELOG.md ${PROJECT_BINARY_DIR}/changelog.Debian
  COMMENT "Writing manual pages and completions" VERBATIM)
add_custom_target(qm_help ALL DEPENDS ${help}.stamp)

install(DIRECTORY ${help}/man/ DESTINATION ${CMAKE_INSTALL_MANDIR} COMPONENT cli
        PATTERN "qm-rps-desktop.1*" EXCLUDE)
install(FILES ${help}/qm-rps.bash DESTINATION ${share}/bash-completion/completions RENAME qm-rps
        COMPONENT cli)
install(FILES ${help}/_qm-rps DESTINATION ${share}/zsh/vendor-completions COMPONENT cli)
# As in the project's folder, so that the links of the guide to the examples hold.
install(DIRECTORY ${PROJECT_SOURCE_DIR}/docs ${PROJECT_SOURCE_DIR}/examples
        DESTINATION ${share}/qm-rps COMPONENT cli)
install(FILES ${PROJECT_SOURCE_DIR}/README.md ${PROJECT_SOURCE_DIR}/CHANGELOG.md
        ${PROJECT_SOURCE_DIR}/CONTRIBUTING.md DESTINATION ${share}/qm-rps COMPONENT cli)

# Each package has its copyright file, notices and changes.
function(qm_install_notices package component)
  set(folder ${share}/doc/${package})
  install(FILES ${packaging}/copyright ${packaging}/NOTICE DESTINATION ${folder}
          COMPONENT ${component})
  install(FILES ${help}/changelog.gz ${help}/changelog.Debian.gz DESTINATION ${folder}
          COMPONENT ${component} OPTIONAL)
endfunction()
qm_install_notices(qm-rps cli)

if(QM_UI)
  qm_install_notices(qm-rps-desktop desktop)
  install(DIRECTORY ${help}/man/man1 DESTINATION ${CMAKE_INSTALL_MANDIR} COMPONENT desktop
          FILES_MATCHING PATTERN "qm-rps-desktop.1*")
  install(FILES ${packaging}/qm-rps-desktop.desktop DESTINATION ${share}/applications
          COMPONENT desktop)
  install(FILES ${packaging}/qm-rps.xml DESTINATION ${share}/mime/packages COMPONENT desktop)
  install(FILES ${packaging}/qm-rps.svg DESTINATION ${share}/icons/hicolor/scalable/apps
          COMPONENT desktop)
  set(QM_RELEASE_DATE 2026-11-23)
  configure_file(${packaging}/qm-rps-desktop.metainfo.xml.in
                 ${PROJECT_BINARY_DIR}/qm-rps-desktop.metainfo.xml @ONLY)
  install(FILES ${PROJECT_BINARY_DIR}/qm-rps-desktop.metainfo.xml DESTINATION ${share}/metainfo
          COMPONENT desktop)
endif()

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME qm-rps)
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
set(CPACK_STRIP_FILES ON)
set(CPACK_COMPONENTS_ALL cli)
set(CPACK_COMPONENTS_GROUPING IGNORE)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_SECTION science)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_CLI_PACKAGE_NAME qm-rps)
set(CPACK_DEBIAN_CLI_PACKAGE_RECOMMENDS fonts-dejavu-core)
set(CPACK_COMPONENT_CLI_DESCRIPTION "The command line: from a pushover analysis, made here or with any solver, to
the performance point (ATC-40, FEMA 440) or the target displacement
(Eurocode 8, NTC), with a trace of every trial, a report and pictures;
plastic hinges by codes; load factors and stay tensions of bridges.")
if(QM_UI)
  list(APPEND CPACK_COMPONENTS_ALL desktop)
  set(CPACK_DEBIAN_DESKTOP_PACKAGE_NAME qm-rps-desktop)
  set(CPACK_DEBIAN_DESKTOP_PACKAGE_DEPENDS
      "qm-rps (= ${PROJECT_VERSION}-${CPACK_DEBIAN_PACKAGE_RELEASE})")
  set(CPACK_COMPONENT_DESKTOP_DESCRIPTION "The windows of qm-rps: frame, hinges, the pushover curve with its performance
points, load factors of bridges, and the report. They do what the commands of
the package qm-rps do, with the same numbers.")
endif()
include(CPack)
