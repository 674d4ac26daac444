# Two Debian packages, made by `cpack` in the build folder: sensor-profile-provider, which can be
# installed without the other, and sensor-profile, with sensorctl and the service.

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME sensor-profile)
# Each package has a summary of its own.
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")
set(CPACK_PACKAGE_CONTACT "The sensor-profile authors <sensor-profile@example.org>")
# Each package is a group: a component of the installation, and the files that only a package has.
set(CPACK_COMPONENTS_ALL provider provider-debian tool tool-debian)
set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_COMPONENTS_GROUPING ONE_PER_GROUP)
set(CPACK_STRIP_FILES ON)
# The unit and its settings lie outside of /usr.
set(CPACK_SET_DESTDIR ON)
set(CPACK_INSTALL_PREFIX /usr)
# cpack creates folders with the umask of the user, which may be restrictive.
set(CPACK_PRE_BUILD_SCRIPTS "${CMAKE_CURRENT_LIST_DIR}/OpenFolders.cmake")

set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_RELEASE 1)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)

set(CPACK_DEBIAN_PROVIDER_PACKAGE_NAME sensor-profile-provider)
set(CPACK_DEBIAN_PROVIDER_PACKAGE_SECTION admin)
set(CPACK_DEBIAN_PROVIDER_DESCRIPTION "hardware sensors as CIM instances: CMPI providers
Fans, voltages and temperatures of a computer for WBEM servers (CIM object
managers): two provider libraries, their classes in MOF, and a command that
registers them in OpenPegasus or sfcb.")

set(CPACK_DEBIAN_TOOL_PACKAGE_NAME sensor-profile)
set(CPACK_DEBIAN_TOOL_PACKAGE_SECTION admin)
set(CPACK_DEBIAN_TOOL_PACKAGE_DEPENDS
  "sensor-profile-provider (= ${PROJECT_VERSION}-${CPACK_DEBIAN_PACKAGE_RELEASE}), adduser")
set(CPACK_DEBIAN_TOOL_PACKAGE_SUGGESTS "lm-sensors, sblim-wbemcli")
set(CPACK_DEBIAN_TOOL_DESCRIPTION "hardware sensors as CIM instances: tool and server
sensorctl shows the fans, voltages and temperatures of a computer as CIM
clients see them, and serves them to such clients over HTTP where no other
object manager runs.")

foreach(component IN ITEMS provider tool)
  string(TOUPPER ${component} name)
  file(GLOB CPACK_DEBIAN_${name}_PACKAGE_CONTROL_EXTRA
    "${CMAKE_CURRENT_LIST_DIR}/debian/${component}/*")
  set(folder doc/${CPACK_DEBIAN_${name}_PACKAGE_NAME})
  install(FILES debian/copyright DESTINATION "${CMAKE_INSTALL_DATADIR}/${folder}"
    COMPONENT ${component}-debian EXCLUDE_FROM_ALL)
  install_compressed(FILE debian/changelog AS changelog.Debian FOLDER ${folder}
    COMPONENT ${component}-debian ON_DEMAND)
endforeach()

include(CPack)
foreach(component IN ITEMS provider tool)
  cpack_add_component_group(${component})
  cpack_add_component(${component} GROUP ${component})
  cpack_add_component(${component}-debian GROUP ${component})
endforeach()
