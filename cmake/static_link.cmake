# vesk_link_statically(PROGRAM): without shared libraries in a Release build, since loading them takes longer than all
# else that happens at a start. Where a library is there as a shared one only, the program is linked as usual. (In other
# builds too: sanitizers need the shared C library.)
include(CheckCXXSourceCompiles)
include(CMakePushCheckState)

function(vesk_link_statically program)
  if(NOT CMAKE_BUILD_TYPE STREQUAL "Release")
    return()
  endif()
  # Not -static: that leaves out the sorted table of functions, and the first exception, which every --help and every
  # mistake on the command line is, waits for it to be made.
  set(options -static-pie)
  cmake_push_check_state(RESET)
  set(CMAKE_REQUIRED_FLAGS -fPIE)
  set(CMAKE_REQUIRED_LINK_OPTIONS ${options})
  set(CMAKE_REQUIRED_LIBRARIES tinfo)
  check_cxx_source_compiles("#include <string>\nint main(int, char** argv) { return std::string(*argv).empty(); }"
    VESK_LINKS_STATICALLY)
  cmake_pop_check_state()
  if(VESK_LINKS_STATICALLY)
    target_link_options(${program} PRIVATE ${options})
  else()
    target_link_options(${program} PRIVATE -pie)
    message(STATUS "No archives of all libraries: ${program} is linked with the shared ones and starts slower")
  endif()
endfunction()
