find_package(Protobuf REQUIRED)

# vesk_generate_messages(TARGET FILE.proto...): adds to the target the message classes of .proto files below its
# folder. They are included as "messages/<folder>/<file>.h". What would not change is left alone, so that nothing is
# compiled again for it.
function(vesk_generate_messages target)
  set(root ${CMAKE_CURRENT_SOURCE_DIR})
  set(out ${CMAKE_BINARY_DIR}/generated/messages)
  set(fresh ${CMAKE_BINARY_DIR}/generated/fresh)
  list(TRANSFORM ARGN PREPEND ${root}/ OUTPUT_VARIABLE protos)
  foreach(proto ${ARGN})
    cmake_path(REMOVE_EXTENSION proto OUTPUT_VARIABLE stem)
    cmake_path(GET proto PARENT_PATH folder)
    file(MAKE_DIRECTORY ${out}/${folder} ${fresh})
    add_custom_command(
      OUTPUT ${out}/${stem}.h ${out}/${stem}.cpp
      COMMAND protobuf::protoc --plugin=protoc-gen-messagegen=$<TARGET_FILE:messagegen>
              --messagegen_out=${fresh} --proto_path=${root} ${proto}
      COMMAND ${CMAKE_COMMAND} -E copy_if_different ${fresh}/${stem}.h ${fresh}/${stem}.cpp ${out}/${folder}
      DEPENDS messagegen ${protos}
      COMMENT "Generating the message classes of ${proto}"
      VERBATIM)
    target_sources(${target} PRIVATE ${out}/${stem}.h ${out}/${stem}.cpp)
  endforeach()
  target_include_directories(${target} PUBLIC ${CMAKE_BINARY_DIR}/generated)
endfunction()
