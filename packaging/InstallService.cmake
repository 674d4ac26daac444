# Installs the service's unit and settings for the prefix that is installed to: in /etc and the
# system's folder of units for /usr, else below the prefix.

if(CMAKE_INSTALL_PREFIX STREQUAL "/usr")
  set(settings /etc/sensor-profile)
  set(units /lib/systemd/system)
else()
  set(settings "${CMAKE_INSTALL_PREFIX}/etc/sensor-profile")
  set(units "${CMAKE_INSTALL_PREFIX}/lib/systemd/system")
endif()

file(READ "${CMAKE_CURRENT_LIST_DIR}/sensor-profile.service" unit)
string(REPLACE "/usr/bin/" "${CMAKE_INSTALL_PREFIX}/bin/" unit "${unit}")
string(REPLACE "/etc/sensor-profile" "${settings}" unit "${unit}")
set(target "$ENV{DESTDIR}${units}/sensor-profile.service")
message(STATUS "Installing: ${target}")
file(WRITE "${target}" "${unit}")
file(CHMOD "${target}" PERMISSIONS OWNER_READ OWNER_WRITE GROUP_READ WORLD_READ)

# What the administrator wrote stays.
if(NOT EXISTS "$ENV{DESTDIR}${settings}/serve.conf")
  file(INSTALL "${CMAKE_CURRENT_LIST_DIR}/serve.conf" DESTINATION "${settings}")
endif()
