# Selects the components of a kind of packages. Read by cpack for each kind that it makes.

string(TOLOWER "${CPACK_GENERATOR}" kind)
set(CPACK_COMPONENTS_ALL provider provider-${kind} tool tool-${kind})
if(kind STREQUAL rpm)
  list(PREPEND CPACK_PRE_BUILD_SCRIPTS "${CMAKE_CURRENT_LIST_DIR}/RpmFolders.cmake")
  # cpack runs it to find out whether rpm supports Suggests, but does not set it.
  set(RPM_EXECUTABLE rpm)
endif()
