# The settings and files of the Debian packages.

set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_RELEASE 1)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)

# The default configuration of libsensors, of which the libraries contain a copy.
set(CPACK_DEBIAN_PROVIDER_PACKAGE_DEPENDS libsensors-config)
set(CPACK_DEBIAN_TOOL_PACKAGE_DEPENDS
  "sensor-profile-provider (= ${PROJECT_VERSION}-${CPACK_DEBIAN_PACKAGE_RELEASE}), adduser")
set(CPACK_DEBIAN_TOOL_PACKAGE_SUGGESTS "lm-sensors, sblim-wbemcli")

foreach(component IN ITEMS provider tool)
  string(TOUPPER ${component} name)
  set(CPACK_DEBIAN_${name}_PACKAGE_NAME ${${component}_package})
  set(CPACK_DEBIAN_${name}_PACKAGE_SECTION admin)
  if(libsensors_source)
    # cpack has no variable for this field, which therefore follows another one.
    string(APPEND CPACK_DEBIAN_${name}_PACKAGE_SECTION "\nBuilt-Using: ${libsensors_source}")
  endif()
  set(CPACK_DEBIAN_${name}_DESCRIPTION "${${component}_summary}\n${${component}_description}")
  file(GLOB CPACK_DEBIAN_${name}_PACKAGE_CONTROL_EXTRA
    "${CMAKE_CURRENT_LIST_DIR}/debian/${component}/*")
  set(folder doc/${${component}_package})
  install(FILES debian/copyright DESTINATION "${CMAKE_INSTALL_DATADIR}/${folder}"
    COMPONENT ${component}-deb EXCLUDE_FROM_ALL)
  install_compressed(FILE debian/changelog AS changelog.Debian FOLDER ${folder}
    COMPONENT ${component}-deb ON_DEMAND)
endforeach()
