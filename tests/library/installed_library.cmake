# Installs the library into a folder of the build, builds the example against it, with its CMake package and
# with pkg-config, and runs it.
set(place "${build}/installed_library")
set(flags "")
if(sanitizers)
  set(flags "-fsanitize=${sanitizers}")
endif()
file(REMOVE_RECURSE "${place}")
file(MAKE_DIRECTORY "${place}/example")

function(run)
  execute_process(COMMAND ${ARGN} WORKING_DIRECTORY "${place}" RESULT_VARIABLE result OUTPUT_VARIABLE output
    ERROR_VARIABLE errors)
  if(NOT result EQUAL 0)
    list(JOIN ARGN " " call)
    message(FATAL_ERROR "${call}: ${result}\n${output}${errors}")
  endif()
  set(output "${output}" PARENT_SCOPE)
endfunction()

foreach(component library development)
  run("${CMAKE_COMMAND}" --install "${build}" --prefix "${place}/usr" --component ${component})
endforeach()

# It must not lean on what lies in the sources.
file(COPY "${source}/examples/library/" DESTINATION "${place}/example")
run("${CMAKE_COMMAND}" -S example -B build -G "${generator}" "-DCMAKE_PREFIX_PATH=${place}/usr"
  "-DCMAKE_CXX_COMPILER=${compiler}" "-DCMAKE_CXX_FLAGS=${flags} -Wall -Wextra -Werror")
run("${CMAKE_COMMAND}" --build build)
run("${place}/build/count_and_rename" "${source}/examples/streeter_phelps.tessal" k1_20 kd river.tessal)
string(FIND "${output}" "deoxygenation = kd*ARRHENIUS20(theta1, temp)*BOD" found)
if(found EQUAL -1)
  message(FATAL_ERROR "The example printed\n${output}")
endif()

find_program(pkg_config pkg-config)
if(pkg_config)
  file(GLOB_RECURSE pc "${place}/usr/*/tessal.pc")
  cmake_path(GET pc PARENT_PATH pc_folder)
  run("${CMAKE_COMMAND}" -E env "PKG_CONFIG_PATH=${pc_folder}" "${pkg_config}" --cflags --libs tessal)
  separate_arguments(options UNIX_COMMAND "${output}")
  separate_arguments(flags UNIX_COMMAND "${flags}")
  run("${compiler}" -std=c++20 ${flags} example/count_and_rename.cpp ${options} -o with_pkg_config)
endif()
