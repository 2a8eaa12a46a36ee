# Where VESK_TIDY is on, a source that clang-tidy objects to does not compile. What is generated is not examined: its
# targets have no CXX_CLANG_TIDY, and of headers and the parts of a unity build only those in these folders are.
if(VESK_TIDY)
  find_program(VESK_CLANG_TIDY clang-tidy REQUIRED)
  set(CMAKE_CXX_CLANG_TIDY ${VESK_CLANG_TIDY} --quiet --header-filter=^${CMAKE_SOURCE_DIR}/\(src|tools|tests|bench|fuzz\)/)
endif()
