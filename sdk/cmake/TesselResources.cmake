# Texts by id: resource scripts become a portable executable without code that the host reads strings from.
find_program(RESOURCE_COMPILER NAMES llvm-rc)
find_program(RESOURCE_LINKER NAMES lld-link)

# add_resource_module(OUTPUT.dll SCRIPT.rc|OBJECT.obj...)
# The scripts are UTF-8 and are not preprocessed, so that no C compiler is needed. The same scripts always give the
# same bytes.
function(add_resource_module output)
  if(NOT RESOURCE_COMPILER OR NOT RESOURCE_LINKER)
    message(FATAL_ERROR "Texts by id are made by llvm-rc and lld-link, which are not there: install LLVM and LLD")
  endif()
  cmake_path(GET output PARENT_PATH folder)
  cmake_path(GET output FILENAME name)
  cmake_path(GET output STEM stem)
  # Compiler and linker take a path that begins with a slash for an option when its first letters are those of one
  # (/check/... is read as /c), so that they are given names relative to the folder they work in.
  # Each output has a folder of its own: others of its name are made at the same time.
  string(MD5 place "${output}")
  set(scratch "${CMAKE_CURRENT_BINARY_DIR}/${stem}.${place}.resources")
  file(MAKE_DIRECTORY "${scratch}")
  file(RELATIVE_PATH relative_output "${scratch}" "${output}")
  foreach(source IN LISTS ARGN)
    cmake_path(ABSOLUTE_PATH source BASE_DIRECTORY "${CMAKE_CURRENT_SOURCE_DIR}")
    list(APPEND sources "${source}")
    file(RELATIVE_PATH linked "${scratch}" "${source}")
    if(source MATCHES "[.]rc$")
      cmake_path(GET source STEM script)
      list(APPEND compile COMMAND ${CMAKE_COMMAND} "-DCOMPILER=${RESOURCE_COMPILER}" "-DSCRIPT=${linked}"
           "-DOUTPUT=${script}.res" -P "${TESSEL_MODULES_FOLDER}/TesselCompileResources.cmake")
      set(linked "${script}.res")
    endif()
    list(APPEND all_linked "${linked}")
  endforeach()
  # The linker insists on an import library; nobody reads it.
  add_custom_command(
    OUTPUT "${output}"
    COMMAND ${CMAKE_COMMAND} -E make_directory "${folder}"
    ${compile}
    COMMAND ${RESOURCE_LINKER} /dll /noentry /machine:x64 /Brepro "/implib:${stem}.lib" "/out:${relative_output}"
            ${all_linked}
    DEPENDS ${sources}
    WORKING_DIRECTORY "${scratch}"
    COMMENT "Making ${name}"
    VERBATIM)
endfunction()
