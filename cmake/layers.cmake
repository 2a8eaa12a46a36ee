# Every target of the project is made by one of these two functions, so that warnings, the include root and the
# link line (what the code may include and call) are stated the same way everywhere.

# What users run lies at another address at each start, guards its buffers, and cannot have its tables overwritten that
# the loader has filled.
add_library(vesk_hardening INTERFACE)
target_compile_options(vesk_hardening INTERFACE
  "$<$<CONFIG:Release>:-fPIE;-fstack-protector-strong;-U_FORTIFY_SOURCE;-D_FORTIFY_SOURCE=2>")
target_link_options(vesk_hardening INTERFACE "$<$<CONFIG:Release>:LINKER:-z,relro,-z,now>")

add_library(vesk_options INTERFACE)
target_link_libraries(vesk_options INTERFACE vesk_hardening)
target_compile_options(vesk_options INTERFACE -Wall -Wextra -Wpedantic -Wconversion -Wshadow -Werror)
target_include_directories(vesk_options INTERFACE ${CMAKE_SOURCE_DIR}/src)

# vesk_layer(NAME SOURCES ... [SHOWS ...] [SEES ...] [USES ...]): one folder of src/ as a library. SHOWS names the layers
# that its headers include, SEES those that only its sources do; USES names libraries from outside the project.
function(vesk_layer name)
  cmake_parse_arguments(LAYER "" "" "SOURCES;SHOWS;SEES;USES" ${ARGN})
  add_library(${name} STATIC ${LAYER_SOURCES})
  target_link_libraries(${name} PUBLIC vesk_options ${LAYER_SHOWS} PRIVATE ${LAYER_SEES} ${LAYER_USES})
  set_target_properties(${name} PROPERTIES UNITY_BUILD ${VESK_UNITY} UNITY_BUILD_BATCH_SIZE 0)
endfunction()

# vesk_program(NAME SOURCES ... [SEES ...] [USES ...]): an executable in bin/.
function(vesk_program name)
  cmake_parse_arguments(PROGRAM "" "" "SOURCES;SEES;USES" ${ARGN})
  add_executable(${name} ${PROGRAM_SOURCES})
  set_target_properties(${name} PROPERTIES UNITY_BUILD ${VESK_UNITY} UNITY_BUILD_BATCH_SIZE 0)
  target_link_libraries(${name} PRIVATE vesk_options ${PROGRAM_SEES} ${PROGRAM_USES})
endfunction()
