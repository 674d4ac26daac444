# Moves files to the folders of RPM distributions, where libraries of 64 bits lie in lib64 and /lib is
# a link. Run by cpack.

set(provider "${CPACK_TEMPORARY_DIRECTORY}/provider")
file(MAKE_DIRECTORY "${provider}/usr/lib64")
file(RENAME "${provider}/usr/lib/cmpi" "${provider}/usr/lib64/cmpi")
file(REMOVE_RECURSE "${provider}/usr/lib")

set(tool "${CPACK_TEMPORARY_DIRECTORY}/tool")
file(RENAME "${tool}/lib/systemd" "${tool}/usr/lib/systemd")
file(RENAME "${tool}/lib/udev" "${tool}/usr/lib/udev")
file(REMOVE_RECURSE "${tool}/lib")
