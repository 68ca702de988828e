# Installation and the Debian package.
#
#   bin/orxkeltools, bin/kelcache
#   libexec/orxkeltools/<command>   one link per command, to ../../bin/orxkeltools:
#                                   put this folder first on PATH to use the
#                                   command names (they would hide the system's
#                                   own ps, lspci, pkill, ... if they were in bin;
#                                   -DORXKEL_LINKS_IN_BIN=ON puts them there too)
#   share/man/man1, man5            orxkeltools(1), kelcache(1), orxkel-snapshot(5)
#   share/bash-completion/completions/orxkeltools (and kelcache, a link to it)
#   share/orxkeltools/examples      the example host: snapshot, cache file, corafs folder
#   share/doc/orxkeltools           README and the format notes

install(TARGETS orxkeltools kelcache RUNTIME DESTINATION ${CMAKE_INSTALL_BINDIR})

# The links are made at configure time in the build tree, relative to where
# they are installed, and installed as links (so the manifest lists them).
set(ORXKEL_LINK_DIR ${CMAKE_INSTALL_LIBEXECDIR}/orxkeltools)
file(RELATIVE_PATH ORXKEL_LINK_TARGET /prefix/${ORXKEL_LINK_DIR} /prefix/${CMAKE_INSTALL_BINDIR}/orxkeltools)
set(ORXKEL_STAGED_LINKS ${CMAKE_BINARY_DIR}/install-links)
file(MAKE_DIRECTORY ${ORXKEL_STAGED_LINKS}/libexec ${ORXKEL_STAGED_LINKS}/bin)
foreach(cmd IN LISTS ORXKEL_COMMANDS)
  file(CREATE_LINK ${ORXKEL_LINK_TARGET} ${ORXKEL_STAGED_LINKS}/libexec/${cmd} SYMBOLIC)
  file(CREATE_LINK orxkeltools ${ORXKEL_STAGED_LINKS}/bin/${cmd} SYMBOLIC)
  list(APPEND ORXKEL_LIBEXEC_LINKS ${ORXKEL_STAGED_LINKS}/libexec/${cmd})
  list(APPEND ORXKEL_BIN_LINKS ${ORXKEL_STAGED_LINKS}/bin/${cmd})
endforeach()
install(FILES ${ORXKEL_LIBEXEC_LINKS} DESTINATION ${ORXKEL_LINK_DIR})
if(ORXKEL_LINKS_IN_BIN)
  install(FILES ${ORXKEL_BIN_LINKS} DESTINATION ${CMAKE_INSTALL_BINDIR})
endif()

install(FILES docs/man/orxkeltools.1 docs/man/kelcache.1 DESTINATION ${CMAKE_INSTALL_MANDIR}/man1)
install(FILES docs/man/orxkel-snapshot.5 DESTINATION ${CMAKE_INSTALL_MANDIR}/man5)

set(ORXKEL_COMPLETIONS ${CMAKE_INSTALL_DATADIR}/bash-completion/completions)
install(FILES completion/orxkeltools.bash DESTINATION ${ORXKEL_COMPLETIONS} RENAME orxkeltools)
file(CREATE_LINK orxkeltools ${ORXKEL_STAGED_LINKS}/kelcache SYMBOLIC)
install(FILES ${ORXKEL_STAGED_LINKS}/kelcache DESTINATION ${ORXKEL_COMPLETIONS})

set(ORXKEL_EXAMPLES ${CMAKE_INSTALL_DATADIR}/orxkeltools/examples)
install(FILES examples/host.json ${CMAKE_BINARY_DIR}/examples/host.cache DESTINATION ${ORXKEL_EXAMPLES})
install(DIRECTORY examples/corafs DESTINATION ${ORXKEL_EXAMPLES})
install(FILES README.md docs/snapshot-format.md docs/simulator.md docs/statuses.md
        DESTINATION ${CMAKE_INSTALL_DOCDIR} OPTIONAL)

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME orxkeltools)
set(CPACK_PACKAGE_VENDOR "orxkeltools")
set(CPACK_PACKAGE_CONTACT "orxkeltools maintainers <orxkeltools@localhost>")
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY
    "diagnostic commands for Orvik hosts, live or from saved cache files")
set(CPACK_PACKAGE_DESCRIPTION
    "One executable with sixteen commands (ps, pidof, pgrep, pkill, lsof, userspaceof, lspci, pci-info, irqinfo, amldump, hwclock, uptime, halvex, bootOption, vdu, vdf) that read an Orvik host's kernel information tree, and kelcache, which builds cache files from JSON snapshots.")
set(CPACK_DEBIAN_PACKAGE_SECTION utils)
set(CPACK_DEBIAN_PACKAGE_DEPENDS "hwdata")
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_STRIP_FILES ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_PACKAGING_INSTALL_PREFIX /usr)
include(CPack)
