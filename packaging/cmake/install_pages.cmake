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
