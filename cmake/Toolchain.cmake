# Language level, warnings, sanitizers and hardening, the same for every room.

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_POSITION_INDEPENDENT_CODE ON)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)
set(CMAKE_VISIBILITY_INLINES_HIDDEN ON)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY "${CMAKE_BINARY_DIR}/lib")
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY "${CMAKE_BINARY_DIR}/bin")

add_compile_options(-Wall -Wextra -Wpedantic -Wconversion -Wshadow)
add_compile_options(-fstack-protector-strong)
add_link_options(-Wl,-z,relro,-z,now)

# Unique symbols would keep the provider library in memory after dlclose.
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
  add_compile_options(-fno-gnu-unique)
  if(CMAKE_UNITY_BUILD)
    # GCC takes the files of a batch for headers.
    add_compile_options(-Wno-subobject-linkage)
    # The compiler collects no garbage, which takes time. A batch needs up to 1.1 GiB, not 0.9.
    add_compile_options(--param=ggc-min-heapsize=4194304)
  endif()
endif()

if(SENSOR_PROFILE_SANITIZE)
  add_compile_options(-fsanitize=${SENSOR_PROFILE_SANITIZE} -fno-omit-frame-pointer)
  add_link_options(-fsanitize=${SENSOR_PROFILE_SANITIZE})
  if(SENSOR_PROFILE_SANITIZE MATCHES "undefined")
    add_compile_options(-fno-sanitize-recover=undefined)
  endif()
elseif(CMAKE_BUILD_TYPE STREQUAL "Release")
  add_compile_options(-U_FORTIFY_SOURCE -D_FORTIFY_SOURCE=2)
endif()

if(SENSOR_PROFILE_COVERAGE)
  # Counters that threads share would otherwise lose counts, even below zero.
  add_compile_options(--coverage -fprofile-update=atomic)
  add_link_options(--coverage)
endif()
