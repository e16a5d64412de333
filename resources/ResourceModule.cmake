# Texts by id: a resource script becomes a portable executable without code that the host reads strings from.
find_program(RESOURCE_COMPILER NAMES llvm-rc llvm-rc-14 REQUIRED)
find_program(RESOURCE_LINKER NAMES lld-link lld-link-14 REQUIRED)

# add_resource_module(TARGET SCRIPT.rc OUTPUT.dll)
# The script is UTF-8 and is not preprocessed, so that no C compiler is needed. The same script always gives the
# same bytes.
function(add_resource_module target script output)
  cmake_path(ABSOLUTE_PATH script BASE_DIRECTORY "${CMAKE_CURRENT_SOURCE_DIR}")
  cmake_path(GET output PARENT_PATH folder)
  cmake_path(GET output FILENAME name)
  set(scratch "${CMAKE_BINARY_DIR}/resource_modules")
  set(compiled "${scratch}/${target}.res")
  # The linker insists on an import library; nobody reads it.
  set(import_library "${scratch}/${target}.lib")
  add_custom_command(
    OUTPUT "${output}"
    BYPRODUCTS "${compiled}"
    COMMAND ${CMAKE_COMMAND} -E make_directory "${folder}" "${scratch}"
    COMMAND ${RESOURCE_COMPILER} /no-preprocess /C 65001 /FO "${compiled}" "${script}"
    COMMAND ${RESOURCE_LINKER} /dll /noentry /machine:x64 /Brepro "/implib:${import_library}" "/out:${output}"
            "${compiled}"
    DEPENDS "${script}"
    COMMENT "Making ${name}"
    VERBATIM)
  add_custom_target(${target} DEPENDS "${output}")
endfunction()
