# zmlr_install_pages(COMPONENT PAGE...): installs manual pages, compressed as Debian wants them. A page is a source file or the output
# of a custom command of the calling folder, and is named NAME.SECTION.
function(zmlr_install_pages component)
  foreach(page ${ARGN})
    get_filename_component(name ${page} NAME)
    get_filename_component(section ${page} LAST_EXT)
    string(SUBSTRING ${section} 1 1 section)
    set(compressed ${CMAKE_BINARY_DIR}/man/${name}.gz)
    add_custom_command(OUTPUT ${compressed}
      COMMAND ${CMAKE_COMMAND} -E make_directory ${CMAKE_BINARY_DIR}/man
      COMMAND gzip -9nc ${page} > ${compressed}
      DEPENDS ${page}
      VERBATIM)
    install(FILES ${compressed} DESTINATION ${CMAKE_INSTALL_MANDIR}/man${section} COMPONENT ${component})
    list(APPEND all ${compressed})
  endforeach()
  string(MD5 names "${ARGN}")
  add_custom_target(pages_${component}_${names} ALL DEPENDS ${all})
endfunction()

# zmlr_install_configured(COMPONENT FOLDER TEMPLATE...): installs NAME of each NAME.in to a folder below the prefix, with @bindir@,
# @sbindir@, @libdir@, @datadir@ and @sysconfdir@ as they are where it is installed: the prefix may be chosen then.
function(zmlr_install_configured component folder)
  foreach(template ${ARGN})
    get_filename_component(template ${template} ABSOLUTE)
    get_filename_component(name ${template} NAME_WLE)
    install(CODE "
      foreach(path bindir=${CMAKE_INSTALL_BINDIR} sbindir=${CMAKE_INSTALL_SBINDIR} libdir=${CMAKE_INSTALL_LIBDIR} datadir=${CMAKE_INSTALL_DATADIR})
        string(REGEX MATCH \"(.*)=(.*)\" path \${path})
        set(\${CMAKE_MATCH_1} \${CMAKE_INSTALL_PREFIX}/\${CMAKE_MATCH_2})
      endforeach()
      include(${CMAKE_SOURCE_DIR}/packaging/cmake/sysconfdir.cmake)
      configure_file(${template} ${CMAKE_CURRENT_BINARY_DIR}/${name} @ONLY)
      file(INSTALL ${CMAKE_CURRENT_BINARY_DIR}/${name} DESTINATION \${CMAKE_INSTALL_PREFIX}/${folder})
    " COMPONENT ${component})
  endforeach()
endfunction()
