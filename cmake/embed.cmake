# vesk_embed(TARGET HEADER NAME FILE...): the files, one behind the other, as the constant NAME of the type PagePart that
# "HEADER" declares, in a source of the target. Run as a script, this file writes that source.
if(NOT CMAKE_SCRIPT_MODE_FILE)
  set(vesk_embed_script ${CMAKE_CURRENT_LIST_FILE})

  function(vesk_embed target header name)
    set(source ${CMAKE_CURRENT_BINARY_DIR}/${name}.cpp)
    add_custom_command(
      OUTPUT ${source}
      COMMAND ${CMAKE_COMMAND} -DSOURCE=${source} -DHEADER=${header} -DNAME=${name} "-DFILES=${ARGN}"
              -P ${vesk_embed_script}
      DEPENDS ${ARGN} ${vesk_embed_script}
      VERBATIM)
    target_sources(${target} PRIVATE ${source})
  endfunction()
  return()
endif()

# base64 OUT HEX: of whole bytes in hexadecimal.
function(base64 out hex)
  set(alphabet ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/)
  string(LENGTH ${hex} digits)
  math(EXPR missing "(6 - ${digits} % 6) % 6")
  string(REPEAT 0 ${missing} zeros)
  string(REGEX MATCHALL "......" triples ${hex}${zeros})
  set(text "")
  foreach(triple ${triples})
    foreach(shift 18 12 6 0)
      math(EXPR place "0x${triple} >> ${shift} & 63")
      string(SUBSTRING ${alphabet} ${place} 1 character)
      string(APPEND text ${character})
    endforeach()
  endforeach()
  math(EXPR padding "${missing} / 2")
  string(LENGTH ${text} length)
  math(EXPR length "${length} - ${padding}")
  string(SUBSTRING ${text} 0 ${length} text)
  string(REPEAT = ${padding} equals)
  set(${out} ${text}${equals} PARENT_SCOPE)
endfunction()

# Without the comments that send a browser's tools to files that are not there.
set(whole ${SOURCE}.content)
file(WRITE ${whole} "")
foreach(file ${FILES})
  file(READ ${file} content)
  string(REGEX REPLACE "(/[*]|//)# sourceMappingURL=[^ *\n]*( ?[*]/)?" "" content "${content}")
  file(APPEND ${whole} "${content}\n")
endforeach()
file(READ ${whole} hex HEX)
file(SHA256 ${whole} hash)
base64(hash ${hash})
string(REGEX REPLACE "(..)" "'\\\\x\\1'," bytes "${hex}")
file(WRITE ${SOURCE} "// Written when the program is built: do not edit.
#include \"${HEADER}\"

namespace vesk::web {

namespace {

constexpr char ${NAME}Bytes[] = {${bytes}};

}  // namespace

const PagePart ${NAME}{{${NAME}Bytes, sizeof ${NAME}Bytes}, \"sha256-${hash}\"};

}  // namespace vesk::web
")
