# The Debian packages: a component each. packaging/debian/COMPONENT holds its description (the first line is the synopsis) and its
# maintainer scripts and other control files; packages/CPackConfig.cmake of the build folder makes them (script/package).

# component  package         section  arch multi-arch depends on, beside the shared libraries                 recommends
set(packages
  "provider   |zmlr-provider  |admin    |any |       |procps, python3:any, tftp-hpa                     |"
  "library    |libhxal1       |libs     |any |same   |                                                  |"
  "development|libhxal-dev    |libdevel |any |same   |libhxal1 (= ${PROJECT_VERSION})                   |"
  "tools      |hxa            |admin    |any |foreign|                                                  |"
  "server     |zmlr-cimserver |admin    |any |foreign|zmlr-provider (= ${PROJECT_VERSION}), systemd, udev|"
  "inventory  |zmlr-inventory |admin    |all |foreign|python3:any                                       |graphviz, python3-pywbem"
  "simulator  |hxasim         |utils    |any |       |                                                  |")

# Who answers for the packages is who builds them, or else who wrote the newest of these sources.
function(git result)
  execute_process(COMMAND git -C ${CMAKE_SOURCE_DIR} ${ARGN} OUTPUT_VARIABLE text OUTPUT_STRIP_TRAILING_WHITESPACE ERROR_QUIET)
  set(${result} ${text} PARENT_SCOPE)
endfunction()
git(name config user.name)
git(mail config user.email)
git(author log -1 "--format=%aN <%aE>")
git(date log -1 --format=%aD)
set(ZMLR_MAINTAINER "" CACHE STRING "Who answers for the packages, if not git's user: name <address>")
if(ZMLR_MAINTAINER)
  set(maintainer ${ZMLR_MAINTAINER})
elseif(name AND mail)
  set(maintainer "${name} <${mail}>")
else()
  set(maintainer ${author})
endif()
if(NOT maintainer)
  file(REMOVE ${CMAKE_BINARY_DIR}/CPackConfig.cmake)
  message(STATUS "No packages: neither git nor ZMLR_MAINTAINER tells who answers for them")
  return()
endif()
if(NOT date)
  string(TIMESTAMP date "%a, %d %b %Y %H:%M:%S +0000" UTC)
endif()

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_VERSION ${PROJECT_VERSION})
set(CPACK_SET_DESTDIR ON)
set(CPACK_INSTALL_PREFIX /usr)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
  OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
set(CPACK_OUTPUT_CONFIG_FILE ${CMAKE_BINARY_DIR}/CPackConfig.cmake)
set(CPACK_COMPONENTS_GROUPING IGNORE)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_COMPRESSION_TYPE xz)
set(CPACK_DEBIAN_PACKAGE_SOURCE zmlr)
set(CPACK_DEBIAN_PACKAGE_MAINTAINER ${maintainer})
set(CPACK_DEBIAN_PACKAGE_PRIORITY optional)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_PRE_BUILD_SCRIPTS ${CMAKE_CURRENT_SOURCE_DIR}/cmake/finish_packages.cmake)

# Whoever is linked with the shared library depends on its package.
set(CPACK_ZMLR_SHLIBS ${CMAKE_CURRENT_BINARY_DIR}/shlibs)
set(CPACK_ZMLR_LIBRARIES /usr/${CMAKE_INSTALL_LIBDIR})
file(WRITE ${CPACK_ZMLR_SHLIBS} "libhxal 1 libhxal1 (>= ${PROJECT_VERSION})\n")

configure_file(debian/changelog.in changelog @ONLY)
add_custom_command(OUTPUT changelog.gz
  COMMAND gzip -9nc changelog > changelog.gz
  DEPENDS ${CMAKE_CURRENT_BINARY_DIR}/changelog
  VERBATIM)
add_custom_target(package_changelog ALL DEPENDS changelog.gz)

get_cmake_property(installed COMPONENTS)
set(CPACK_COMPONENTS_ALL)
foreach(row ${packages})
  string(REGEX REPLACE " *\\| *" ";" row "${row}")
  list(GET row 0 component)
  list(GET row 1 package)
  list(GET row 2 section)
  list(GET row 3 architecture)
  list(GET row 4 multiarch)
  list(GET row 5 depends)
  list(GET row 6 recommends)
  if(NOT component IN_LIST installed)
    continue()
  endif()
  list(APPEND CPACK_COMPONENTS_ALL ${component})
  install(FILES ${CMAKE_CURRENT_BINARY_DIR}/changelog.gz DESTINATION ${CMAKE_INSTALL_DATADIR}/doc/${package} COMPONENT ${component})

  set(control ${CMAKE_CURRENT_SOURCE_DIR}/debian/${component})
  file(GLOB extra CONFIGURE_DEPENDS ${control}/*)
  list(REMOVE_ITEM extra ${control}/description ${control}/lintian-overrides)
  if(EXISTS ${control}/lintian-overrides)
    install(FILES ${control}/lintian-overrides DESTINATION ${CMAKE_INSTALL_DATADIR}/lintian/overrides RENAME ${package}
            COMPONENT ${component})
  endif()
  if(component STREQUAL library)
    list(APPEND extra ${CPACK_ZMLR_SHLIBS})
  endif()
  if(multiarch) # CPack has no variable for it before 3.31
    string(APPEND section "\nMulti-Arch: ${multiarch}")
  endif()
  file(READ ${control}/description description)
  string(STRIP "${description}" description)

  string(TOUPPER ${component} COMPONENT)
  set(CPACK_DEBIAN_${COMPONENT}_PACKAGE_NAME ${package})
  set(CPACK_DEBIAN_${COMPONENT}_PACKAGE_SECTION ${section})
  set(CPACK_DEBIAN_${COMPONENT}_PACKAGE_DEPENDS "${depends}")
  set(CPACK_DEBIAN_${COMPONENT}_PACKAGE_RECOMMENDS "${recommends}")
  set(CPACK_DEBIAN_${COMPONENT}_PACKAGE_CONTROL_EXTRA "${extra}")
  set(CPACK_DEBIAN_${COMPONENT}_DESCRIPTION "${description}")
  if(architecture STREQUAL all)
    set(CPACK_DEBIAN_${COMPONENT}_PACKAGE_ARCHITECTURE all)
  endif()
endforeach()

include(CPack)
