# vesk_generate_messages(TARGET FILE.proto...): adds to the target the message classes of .proto files below its
# folder. They are included as "messages/<folder>/<file>.h".
function(vesk_generate_messages target)
  set(root ${CMAKE_CURRENT_SOURCE_DIR})
  set(out ${CMAKE_BINARY_DIR}/generated/messages)
  list(TRANSFORM ARGN PREPEND ${root}/ OUTPUT_VARIABLE protos)
  foreach(proto ${ARGN})
    string(REGEX REPLACE "\\.proto$" "" stem ${proto})
    list(APPEND generated ${out}/${stem}.h ${out}/${stem}.cpp)
  endforeach()
  add_custom_command(
    OUTPUT ${generated}
    COMMAND messagegen ${root} ${out} ${ARGN}
    DEPENDS messagegen ${protos}
    COMMENT "Generating the message classes"
    VERBATIM)
  target_sources(${target} PRIVATE ${generated})
  target_include_directories(${target} PUBLIC ${CMAKE_BINARY_DIR}/generated)
endfunction()
