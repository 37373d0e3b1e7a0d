# Installs the settings of the embedded server unless they are there: they are the host's from then on. No user, no password.
include(${CMAKE_CURRENT_LIST_DIR}/sysconfdir.cmake)
if(NOT EXISTS $ENV{DESTDIR}${sysconfdir}/zmlr/users)
  file(WRITE ${build}/users "")
  file(INSTALL ${build}/users DESTINATION ${sysconfdir}/zmlr PERMISSIONS OWNER_READ OWNER_WRITE)
endif()
if(NOT EXISTS $ENV{DESTDIR}${sysconfdir}/default/zmlr-cimserver)
  file(INSTALL ${CMAKE_CURRENT_LIST_DIR}/../systemd/zmlr-cimserver.default DESTINATION ${sysconfdir}/default RENAME zmlr-cimserver)
endif()
