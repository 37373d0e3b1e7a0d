# Run by CPack when everything lies in folders of its own, before it makes packages of them: takes the paths of libraries out of the
# programs, strips as Debian does, and asks dpkg-shlibdeps what the programs and libraries need.
set(stripping --strip-unneeded --remove-section=.comment --remove-section=.note)
set(work ${CPACK_TEMPORARY_DIRECTORY}/shlibdeps)
file(WRITE ${work}/debian/control "Source: zmlr\n\nPackage: zmlr\nArchitecture: any\n")

foreach(component ${CPACK_COMPONENTS_ALL})
  set(binaries)
  file(GLOB_RECURSE files LIST_DIRECTORIES false ${CPACK_TEMPORARY_DIRECTORY}/${component}/*)
  foreach(file ${files})
    if(IS_SYMLINK ${file})
      continue()
    endif()
    file(READ ${file} magic LIMIT 8 HEX)
    if(magic MATCHES ^7f454c46)
      list(APPEND binaries ${file})
      file(RPATH_REMOVE FILE ${file})
      execute_process(COMMAND strip ${stripping} ${file} COMMAND_ERROR_IS_FATAL ANY)
    elseif(magic STREQUAL 213c617263683e0a)
      execute_process(COMMAND strip --strip-debug --remove-section=.comment --enable-deterministic-archives ${file}
                      COMMAND_ERROR_IS_FATAL ANY)
    endif()
  endforeach()
  if(NOT binaries)
    continue()
  endif()

  execute_process(COMMAND dpkg-shlibdeps -O -L${CPACK_ZMLR_SHLIBS} -l${CPACK_TEMPORARY_DIRECTORY}/library${CPACK_ZMLR_LIBRARIES} ${binaries}
                  WORKING_DIRECTORY ${work} OUTPUT_VARIABLE needed ERROR_VARIABLE told RESULT_VARIABLE status
                  OUTPUT_STRIP_TRAILING_WHITESPACE)
  if(NOT status EQUAL 0)
    message(FATAL_ERROR "${told}")
  endif()
  string(REPLACE shlibs:Depends= "" needed "${needed}")
  string(TOUPPER ${component} COMPONENT)
  set(depends ${CPACK_DEBIAN_${COMPONENT}_PACKAGE_DEPENDS} ${needed})
  list(JOIN depends ", " CPACK_DEBIAN_${COMPONENT}_PACKAGE_DEPENDS)
endforeach()
file(REMOVE_RECURSE ${work})
