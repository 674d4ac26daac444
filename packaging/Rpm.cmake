# The settings and files of the RPM packages, for Fedora and SUSE. The packages require the versions
# of libraries that they were built with, by their sonames.

set(CPACK_RPM_COMPONENT_INSTALL ON)
set(CPACK_RPM_FILE_NAME RPM-DEFAULT)
set(CPACK_RPM_PACKAGE_RELEASE 1)
set(CPACK_RPM_PACKAGE_LICENSE Apache-2.0)
set(CPACK_RPM_PACKAGE_GROUP System/Management)
set(CPACK_RPM_CHANGELOG_FILE "${CMAKE_CURRENT_LIST_DIR}/rpm/changelog")
set(CPACK_RPM_SPEC_MORE_DEFINE "%define packager ${CPACK_PACKAGE_CONTACT}")
# These folders belong to packages of the system.
set(CPACK_RPM_EXCLUDE_FROM_AUTO_FILELIST_ADDITION
  /usr/lib/systemd /usr/lib/systemd/system /usr/lib/sysusers.d /usr/lib/udev
  /usr/lib/udev/rules.d /usr/libexec /usr/sbin /usr/share/licenses
  /usr/share/man /usr/share/man/man1 /usr/share/man/man5 /usr/share/man/man7 /usr/share/man/man8
  # Both packages have files in this folder. It belongs to the provider's.
  /usr/share/sensor-profile)
set(CPACK_RPM_PROVIDER_USER_FILELIST "%dir /usr/share/sensor-profile")

# Object managers load the libraries by their paths: no program links to them.
set(CPACK_RPM_PROVIDER_PACKAGE_AUTOPROV no)
# The registration of sfcb uses find, which is not in every installation.
set(CPACK_RPM_PROVIDER_PACKAGE_REQUIRES /usr/bin/find)
set(CPACK_RPM_TOOL_PACKAGE_REQUIRES "sensor-profile-provider%{?_isa} = %{version}-%{release}")
set(CPACK_RPM_TOOL_PACKAGE_SUGGESTS "lm_sensors, sblim-wbemcli")
foreach(step IN ITEMS POST PREUN POSTUN)
  set(CPACK_RPM_TOOL_PACKAGE_REQUIRES_${step} systemd)
endforeach()
set(CPACK_RPM_TOOL_POST_INSTALL_SCRIPT_FILE "${CMAKE_CURRENT_LIST_DIR}/rpm/tool/post")
set(CPACK_RPM_TOOL_PRE_UNINSTALL_SCRIPT_FILE "${CMAKE_CURRENT_LIST_DIR}/rpm/tool/preun")
set(CPACK_RPM_TOOL_POST_UNINSTALL_SCRIPT_FILE "${CMAKE_CURRENT_LIST_DIR}/rpm/tool/postun")
set(CPACK_RPM_TOOL_USER_FILELIST "%config(noreplace) /etc/sensor-profile/serve.conf")
install(FILES rpm/sysusers.conf DESTINATION lib/sysusers.d RENAME sensor-profile.conf
  COMPONENT tool-rpm EXCLUDE_FROM_ALL)

foreach(component IN ITEMS provider tool)
  string(TOUPPER ${component} name)
  set(CPACK_RPM_${name}_PACKAGE_NAME ${${component}_package})
  # Summaries of Debian packages begin with a small letter.
  string(REGEX REPLACE "^hardware" "Hardware" CPACK_RPM_${name}_PACKAGE_SUMMARY
    "${${component}_summary}")
  set(CPACK_RPM_${name}_PACKAGE_DESCRIPTION "${${component}_description}")
  if(LIBSENSORS_ARCHIVE)
    string(REGEX REPLACE ".*= ([0-9]+:)?([^-]*).*" " = \\2" version "${libsensors_source}")
    set(CPACK_RPM_${name}_PACKAGE_PROVIDES "bundled(lm_sensors)${version}")
  endif()
  set(licence "${CMAKE_INSTALL_DATADIR}/licenses/${${component}_package}")
  install(FILES "${PROJECT_SOURCE_DIR}/LICENSE" DESTINATION "${licence}"
    COMPONENT ${component}-rpm EXCLUDE_FROM_ALL)
  list(APPEND CPACK_RPM_${name}_USER_FILELIST "%license /usr/${licence}/LICENSE")
endforeach()
