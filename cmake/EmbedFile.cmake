# Puts the text of a file into a program as a constant, so that there is no file to find when the
# program runs.
#
# nidus_embed(TARGET FILE NAME): adds to TARGET the constant `nidus::NAME`, a std::string_view of
# the text of FILE. The code that uses it declares `extern const std::string_view NAME;`.

if(CMAKE_SCRIPT_MODE_FILE)
  file(READ "${INPUT}" text)
  file(WRITE "${OUTPUT}" "#include <string_view>

namespace nidus {
extern const std::string_view ${NAME};
const std::string_view ${NAME} = R\"nidus(${text})nidus\";
}  // namespace nidus
")
  return()
endif()

set(NIDUS_EMBED_SCRIPT ${CMAKE_CURRENT_LIST_FILE})

function(nidus_embed target file name)
  set(output ${CMAKE_CURRENT_BINARY_DIR}/${name}.cpp)
  add_custom_command(OUTPUT ${output}
    COMMAND ${CMAKE_COMMAND} -DINPUT=${file} -DOUTPUT=${output} -DNAME=${name}
            -P ${NIDUS_EMBED_SCRIPT}
    DEPENDS ${file} ${NIDUS_EMBED_SCRIPT} VERBATIM)
  target_sources(${target} PRIVATE ${output})
  set_source_files_properties(${output} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
endfunction()
