# `static_checks`: clang-tidy over the C++ of the product, each file again only when it or a header has changed.
find_program(CLANG_TIDY NAMES clang-tidy clang-tidy-14)
add_custom_target(static_checks)

# Checks the C++ sources of a target.
function(add_static_checks target)
  if(NOT CLANG_TIDY)
    return()
  endif()
  get_target_property(sources ${target} SOURCES)
  get_target_property(folder ${target} SOURCE_DIR)
  file(GLOB_RECURSE headers CONFIGURE_DEPENDS "${CMAKE_SOURCE_DIR}/sdk/*.h" "${CMAKE_SOURCE_DIR}/modrig/*.h"
       "${CMAKE_SOURCE_DIR}/host/*.h")
  foreach(source IN LISTS sources)
    cmake_path(ABSOLUTE_PATH source BASE_DIRECTORY "${folder}" NORMALIZE)
    cmake_path(IS_PREFIX CMAKE_BINARY_DIR "${source}" generated)
    if(generated OR NOT source MATCHES "\\.cpp$")
      continue()
    endif()
    cmake_path(RELATIVE_PATH source BASE_DIRECTORY "${CMAKE_SOURCE_DIR}" OUTPUT_VARIABLE name)
    set(stamp "${CMAKE_BINARY_DIR}/static_checks/${name}.checked")
    cmake_path(GET stamp PARENT_PATH stamp_folder)
    add_custom_command(
      OUTPUT "${stamp}"
      COMMAND ${CMAKE_COMMAND} -E make_directory "${stamp_folder}"
      # What it says on standard error counts warnings in the system's headers; it is shown only with a failure.
      COMMAND sh -c "\"$@\" 2>'${stamp}.log' || { cat '${stamp}.log'; exit 1; }" static_check
              ${CLANG_TIDY} --quiet --extra-arg=-Wno-unknown-warning-option -p "${CMAKE_BINARY_DIR}" "${source}"
      COMMAND ${CMAKE_COMMAND} -E touch "${stamp}"
      DEPENDS "${source}" ${headers} "${CMAKE_SOURCE_DIR}/.clang-tidy"
      COMMENT "Checking ${name}"
      VERBATIM)
    list(APPEND stamps "${stamp}")
  endforeach()
  add_custom_target(static_checks_${target} DEPENDS ${stamps})
  # Generated sources have to be there.
  add_dependencies(static_checks_${target} ${target})
  add_dependencies(static_checks static_checks_${target})
endfunction()
