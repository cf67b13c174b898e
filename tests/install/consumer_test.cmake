# Installs the library, moves the installed tree, and builds and runs a program against it in both ways that users have:
# find_package and pkg-config. The program is compiled with the flags of the library, so that a sanitizer is in both.
set(prefix ${WORK_DIR}/moved)
file(REMOVE_RECURSE ${WORK_DIR})
set(ENV{DESTDIR} "")

function(run)
  execute_process(COMMAND ${ARGN} OUTPUT_VARIABLE output ERROR_VARIABLE output RESULT_VARIABLE code)
  if(NOT code EQUAL 0)
    message(FATAL_ERROR "${ARGN}\nended with ${code}:\n${output}")
  endif()
  set(output "${output}" PARENT_SCOPE)
endfunction()

run(${CMAKE_COMMAND} --install ${BUILD_DIR} --prefix ${WORK_DIR}/installed)
file(RENAME ${WORK_DIR}/installed ${prefix})

foreach(name include/hqf/hqf.h include/hqf/model/Hqf.h ${LIBDIR}/libhqf.so ${LIBDIR}/libhqf.so.0
        include/hqf/flat/hqf_flat.h ${LIBDIR}/cmake/hqf/hqfConfig.cmake ${LIBDIR}/pkgconfig/hqf.pc share/hqf/hqf-v2.xsd)
  if(NOT EXISTS ${prefix}/${name})
    message(FATAL_ERROR "${name} is not installed")
  endif()
endforeach()

# What users link must not depend on how the library is built.
file(GLOB package_files ${prefix}/${LIBDIR}/cmake/hqf/*.cmake ${prefix}/${LIBDIR}/pkgconfig/hqf.pc)
foreach(name ${package_files})
  file(READ ${name} text)
  if(text MATCHES "hqf_objects|[Xx]ml2|ZLIB|BZip2|/generated")
    message(FATAL_ERROR "${name} tells of the library's insides: ${CMAKE_MATCH_0}")
  endif()
endforeach()

# The headers compile with nothing but the installed tree. One is about libxml2's own names and needs its headers.
file(GLOB_RECURSE headers RELATIVE ${prefix}/include ${prefix}/include/*.h)
list(REMOVE_ITEM headers hqf/values/xml_regexp.h)
list(TRANSFORM headers REPLACE "(.+)" "#include <\\1>")
list(JOIN headers "\n" headers)
file(WRITE ${WORK_DIR}/all_headers.cpp "${headers}\n")

# One of them is for C.
file(WRITE ${WORK_DIR}/flat.c "#include <hqf/flat/hqf_flat.h>\n")
run(${COMPILER} -x c -std=c11 -pedantic -Wall -Wextra -Werror -fsyntax-only -I${prefix}/include ${WORK_DIR}/flat.c)

run(${CMAKE_COMMAND} -S ${CONSUMER} -B ${WORK_DIR}/build -D CMAKE_PREFIX_PATH=${prefix}
    -D CMAKE_CXX_COMPILER=${COMPILER} "-DCMAKE_CXX_FLAGS=${FLAGS}" -D ALL_HEADERS=${WORK_DIR}/all_headers.cpp)
run(${CMAKE_COMMAND} --build ${WORK_DIR}/build)
run(${WORK_DIR}/build/consumer ${WORK_DIR}/by_cmake.hqf)

if(NOT PKG_CONFIG)
  message(STATUS "pkg-config is not installed: its half is left out")
  return()
endif()
set(ENV{PKG_CONFIG_PATH} ${prefix}/${LIBDIR}/pkgconfig)
run(${PKG_CONFIG} --cflags --libs hqf)
separate_arguments(module_flags UNIX_COMMAND "${output}")
separate_arguments(flags UNIX_COMMAND "${FLAGS}")
run(${COMPILER} -std=c++20 ${flags} ${CONSUMER}/consumer.cpp ${module_flags} -o ${WORK_DIR}/by_pkg_config)
set(ENV{LD_LIBRARY_PATH} ${prefix}/${LIBDIR})
run(${WORK_DIR}/by_pkg_config ${WORK_DIR}/by_pkg_config.hqf)
