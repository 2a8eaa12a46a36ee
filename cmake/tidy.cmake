# Where VESK_TIDY is on, a source of a layer or of the generator that clang-tidy objects to does not compile. What is
# generated is not examined: only what lies in these folders is, whether as a source, as a header or as a part of a unity
# build.
if(VESK_TIDY)
  find_program(VESK_CLANG_TIDY clang-tidy REQUIRED)
  set(VESK_TIDY_COMMAND ${VESK_CLANG_TIDY} --quiet --header-filter=^${CMAKE_SOURCE_DIR}/\(src|tools|tests|bench|fuzz\)/)
endif()
