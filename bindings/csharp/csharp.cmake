# How C# is compiled and run.
find_program(HQF_MCS mcs REQUIRED)
find_program(HQF_MONO mono REQUIRED)

set(HQF_CSHARP_DIR ${PROJECT_BINARY_DIR}/bindings/csharp)

# csharp_program(target output FLAGS ... SOURCES ... DEPENDS ...): compiles one assembly; warnings are errors where they
# are in C++.
function(csharp_program target output)
  cmake_parse_arguments(PARSE_ARGV 2 arg "" "" "FLAGS;SOURCES;DEPENDS")
  set(sources)
  foreach(source IN LISTS arg_SOURCES)
    cmake_path(ABSOLUTE_PATH source)
    list(APPEND sources ${source})
  endforeach()
  add_custom_command(
    OUTPUT ${output}
    COMMAND ${HQF_MCS} -nologo -optimize -warn:4 $<$<BOOL:${HQF_WERROR}>:-warnaserror> ${arg_FLAGS} -out:${output}
            ${sources}
    DEPENDS ${sources} ${arg_DEPENDS}
    COMMENT "Compiling ${target}" VERBATIM COMMAND_EXPAND_LISTS)
  add_custom_target(${target} ALL DEPENDS ${output})
endfunction()

# csharp_user(target sources...): a program that uses Hqf.dll.
function(csharp_user target)
  csharp_program(${target} ${CMAKE_CURRENT_BINARY_DIR}/${target}.exe
                 FLAGS -r:${HQF_CSHARP_DIR}/Hqf.dll SOURCES ${ARGN} DEPENDS ${HQF_CSHARP_DIR}/Hqf.dll)
  add_dependencies(${target} hqf_csharp hqf)
endfunction()

# csharp_run(variable target NAME=VALUE...): the command that runs such a program in this environment.
function(csharp_run variable target)
  set(${variable} ${CMAKE_COMMAND} -E env MONO_PATH=${HQF_CSHARP_DIR} LD_LIBRARY_PATH=$<TARGET_FILE_DIR:hqf>
                  ${ARGN} ${HQF_MONO} ${CMAKE_CURRENT_BINARY_DIR}/${target}.exe PARENT_SCOPE)
endfunction()
