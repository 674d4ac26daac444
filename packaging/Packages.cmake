# Two packages, made by `cpack` in the build folder: sensor-profile-provider, which can be installed
# without the other, and sensor-profile, with sensorctl and the service. They are Debian packages;
# `cpack -G RPM` makes RPM packages.

set(CPACK_GENERATOR DEB)
set(CPACK_PACKAGE_NAME sensor-profile)
# Each package has a summary of its own.
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")
set(CPACK_PACKAGE_VENDOR "The sensor-profile authors")
set(CPACK_PACKAGE_CONTACT "The sensor-profile authors <sensor-profile@example.org>")
# Each package is a group: a component of the installation, and the files that only this kind of
# package has. PackageKind.cmake selects those of one kind.
set(CPACK_COMPONENTS_ALL provider provider-deb provider-rpm tool tool-deb tool-rpm)
set(CPACK_PROJECT_CONFIG_FILE "${CMAKE_CURRENT_LIST_DIR}/PackageKind.cmake")
set(CPACK_COMPONENTS_GROUPING ONE_PER_GROUP)
set(CPACK_STRIP_FILES ON)
# The unit and its settings lie outside of /usr.
set(CPACK_SET_DESTDIR ON)
set(CPACK_INSTALL_PREFIX /usr)
set(CPACK_PACKAGE_RELOCATABLE OFF)
# cpack creates folders with the umask of the user, which may be restrictive.
set(CPACK_PRE_BUILD_SCRIPTS "${CMAKE_CURRENT_LIST_DIR}/OpenFolders.cmake")

set(provider_package sensor-profile-provider)
set(provider_summary "hardware sensors as CIM instances: CMPI providers")
set(provider_description
  "Fans, voltages and temperatures of a computer for WBEM servers (CIM object
managers): two provider libraries, their classes in MOF, and a command that
registers them in OpenPegasus or sfcb.")
set(tool_package sensor-profile)
set(tool_summary "hardware sensors as CIM instances: tool and server")
set(tool_description
  "sensorctl shows the fans, voltages and temperatures of a computer as CIM
clients see them, and serves them to such clients over HTTP where no other
object manager runs.")

# The source of the copy of libsensors that both packages contain, such as
# `lm-sensors (= 1:3.6.0-7.1)`; empty where it is not from a Debian package.
set(libsensors_source)
find_program(DPKG_QUERY dpkg-query)
if(LIBSENSORS_ARCHIVE AND DPKG_QUERY)
  execute_process(
    COMMAND "${DPKG_QUERY}" --show "--showformat=\${source:Package} (= \${source:Version})"
      libsensors-dev
    OUTPUT_VARIABLE libsensors_source ERROR_QUIET)
endif()

include(Debian.cmake)
include(Rpm.cmake)

include(CPack)
foreach(component IN ITEMS provider tool)
  cpack_add_component_group(${component})
  foreach(part IN ITEMS ${component} ${component}-deb ${component}-rpm)
    cpack_add_component(${part} GROUP ${component})
  endforeach()
endforeach()
