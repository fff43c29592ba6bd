# Turns a vocabulary document into code, so that the program need not parse its own vocabulary each
# time it starts.
#
# nidus_vocabulary(TARGET FILE): adds to TARGET the function `nidus::builtInVocabulary()`, declared in
# HomePlatform/Metadata/VocabularyReader.h, which makes the entries of FILE.

if(NOT CMAKE_SCRIPT_MODE_FILE)
  set(NIDUS_VOCABULARY_SCRIPT ${CMAKE_CURRENT_LIST_FILE})

  function(nidus_vocabulary target file)
    set(output ${CMAKE_CURRENT_BINARY_DIR}/BuiltInVocabulary.cpp)
    add_custom_command(OUTPUT ${output}
      COMMAND ${CMAKE_COMMAND} -DINPUT=${file} -DOUTPUT=${output} -P ${NIDUS_VOCABULARY_SCRIPT}
      DEPENDS ${file} ${NIDUS_VOCABULARY_SCRIPT} VERBATIM)
    target_sources(${target} PRIVATE ${output})
    set_source_files_properties(${output} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
  endfunction()
  return()
endif()

# The text of a member as C++, or nullptr.
function(read_text result object key)
  string(JSON text ERROR_VARIABLE missing GET "${object}" ${key})
  if(missing)
    set(${result} nullptr PARENT_SCOPE)
  else()
    set(${result} "R\"nidus(${text})nidus\"" PARENT_SCOPE)
  endif()
endfunction()

# The flag of a member as C++.
function(read_flag result object key)
  string(JSON flag ERROR_VARIABLE missing GET "${object}" ${key})
  if(flag AND NOT missing)
    set(${result} true PARENT_SCOPE)
  else()
    set(${result} false PARENT_SCOPE)
  endif()
endfunction()

# One side of a pair of values as C++ that makes a boxed value.
function(read_value result pair side)
  string(JSON type TYPE "${pair}" ${side})
  string(JSON value GET "${pair}" ${side})
  if(type STREQUAL "BOOLEAN")
    read_flag(flag "${pair}" ${side})
    set(${result} "NDValue::boolean(${flag})" PARENT_SCOPE)
  elseif(type STREQUAL "NUMBER" AND value MATCHES "^-?[0-9]+$")
    set(${result} "NDValue::integer(${value})" PARENT_SCOPE)
  elseif(type STREQUAL "STRING")
    set(${result} "NDValue::text(R\"nidus(${value})nidus\")" PARENT_SCOPE)
  else()
    message(FATAL_ERROR "${INPUT}: a ${type} such as ${value} cannot be put into a table")
  endif()
endfunction()

function(read_values result entry)
  set(pairs "")
  string(JSON count ERROR_VARIABLE missing LENGTH "${entry}" values)
  if(NOT missing AND count GREATER 0)
    math(EXPR last "${count} - 1")
    foreach(index RANGE ${last})
      string(JSON pair GET "${entry}" values ${index})
      read_value(assistant "${pair}" assistant)
      read_value(platform "${pair}" platform)
      string(APPEND pairs "{${assistant}, ${platform}}, ")
    endforeach()
  endif()
  set(${result} "{${pairs}}" PARENT_SCOPE)
endfunction()

# The entries of one list as C++: the texts, then, with `isFull`, the flags and the values.
function(read_list result list isFull)
  set(entries "")
  string(JSON count LENGTH "${document}" ${list})
  math(EXPR last "${count} - 1")
  foreach(index RANGE ${last})
    string(JSON entry GET "${document}" ${list} ${index})
    set(members "")
    foreach(key ${ARGN})
      read_text(text "${entry}" ${key})
      list(APPEND members "${text}")
    endforeach()
    if(isFull)
      foreach(key localized follows)
        read_flag(flag "${entry}" ${key})
        list(APPEND members ${flag})
      endforeach()
      read_values(values "${entry}")
      list(APPEND members "${values}")
    endif()
    list(JOIN members ", " members)
    string(APPEND entries "      {${members}},\n")
  endforeach()
  set(${result} "{\n${entries}  }" PARENT_SCOPE)
endfunction()

file(READ "${INPUT}" document)
read_list(services services NO assistantName serviceType)
read_list(characteristics characteristics YES assistantName read write valueType unit)
read_list(units units NO assistantName unit)
file(WRITE "${OUTPUT}" "#include \"HomePlatform/Metadata/VocabularyReader.h\"

namespace nidus {

Vocabulary builtInVocabulary() {
  Vocabulary vocabulary;
  vocabulary.services = ${services};
  vocabulary.characteristics = ${characteristics};
  vocabulary.units = ${units};
  return vocabulary;
}

}  // namespace nidus
")
