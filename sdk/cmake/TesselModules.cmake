# What a module's author calls, once find_package(Tessel) has found the SDK:
#
# tessel_add_module(NAME [KIND zmb|omp] [FOLDER folder] source...)
#   A module that is one shared library: NAME.zmb, unless another KIND is asked for.
# tessel_add_bundle(NAME [IDENTIFIER identifier] [TEXTS script.rc] [RESOURCES folder] [FOLDER folder] source...)
#   A bundle, NAME.bundle. IDENTIFIER: what the system knows it by, org.example.NAME unless it is given. TEXTS: a script
#   of texts by id, which becomes a file with .dll in the place of .rc. RESOURCES: a folder, whose content joins the
#   bundle's resources.
# tessel_add_lisp(NAME [FOLDER folder] source.lsp)
#   Compiled Lisp, NAME.qbc.
# tessel_add_test(NAME MODULE module [TYPES command...] SHOWS text...)
#   A test of ctest: Tessel loads the module in a profile of the test's own, the commands are typed, and every text has
#   to be in what is shown then. A command that fails makes the test fail.
#
# A bundle has the version of the project that it is built in, 1.0 where that has none. On macOS it says from which
# system on it runs, where CMAKE_OSX_DEPLOYMENT_TARGET does.
#
# Modules are built in the current build folder, or in a FOLDER, which may be given from there. Each is a target of CMake's of that NAME. One
# of C++ links with all of the host's services, exports its entry point alone and tells the version of the SDK.
include_guard(GLOBAL)
include("${CMAKE_CURRENT_LIST_DIR}/TesselResources.cmake")
set(TESSEL_MODULES_FOLDER "${CMAKE_CURRENT_LIST_DIR}" CACHE INTERNAL "Where the files of these functions stand")

# Makes the folder in that variable a whole path, that of the build folder where none is given.
macro(tessel_take_folder folder)
  if(NOT ${folder})
    set(${folder} "${CMAKE_CURRENT_BINARY_DIR}")
  endif()
  cmake_path(ABSOLUTE_PATH ${folder} BASE_DIRECTORY "${CMAKE_CURRENT_BINARY_DIR}" NORMALIZE)
endmacro()

function(tessel_add_module name)
  cmake_parse_arguments(PARSE_ARGV 1 MODULE "" "KIND;FOLDER" "")
  if(NOT MODULE_KIND)
    set(MODULE_KIND zmb)
  endif()
  if(NOT MODULE_KIND MATCHES "^(zmb|omp)$")
    message(FATAL_ERROR "tessel_add_module(${name}): KIND is zmb or omp, and not ${MODULE_KIND}")
  endif()
  tessel_take_folder(MODULE_FOLDER)
  tessel_add_library(${name} ${name}.${MODULE_KIND} "${MODULE_FOLDER}" ${MODULE_UNPARSED_ARGUMENTS})
  set_target_properties(${name} PROPERTIES TESSEL_PATH "${MODULE_FOLDER}/${name}.${MODULE_KIND}")
endfunction()

function(tessel_add_bundle name)
  cmake_parse_arguments(PARSE_ARGV 1 BUNDLE "" "IDENTIFIER;TEXTS;RESOURCES;FOLDER" "")
  tessel_take_folder(BUNDLE_FOLDER)
  if(NOT BUNDLE_IDENTIFIER)
    set(BUNDLE_IDENTIFIER "org.example.${name}")
  endif()
  set(bundle "${BUNDLE_FOLDER}/${name}.bundle")
  if(APPLE)
    set(binaries "${bundle}/Contents/MacOS")
    set(resources "${bundle}/Contents/Resources")
    set(info "${bundle}/Contents/Info.plist")
  else()
    set(binaries "${bundle}")
    set(resources "${bundle}/Resources")
    set(info "${resources}/Info-gnustep.plist")
  endif()
  tessel_add_library(${name} ${name} "${binaries}" ${BUNDLE_UNPARSED_ARGUMENTS})
  set_target_properties(${name} PROPERTIES TESSEL_PATH "${bundle}")
  set(BUNDLE_NAME ${name})
  set(BUNDLE_VERSION "${PROJECT_VERSION}")
  if(NOT BUNDLE_VERSION)
    set(BUNDLE_VERSION 1.0)
  endif()
  set(BUNDLE_OLDEST_SYSTEM "")
  if(CMAKE_OSX_DEPLOYMENT_TARGET)
    string(CONCAT BUNDLE_OLDEST_SYSTEM "    <key>LSMinimumSystemVersion</key>\n"
      "    <string>${CMAKE_OSX_DEPLOYMENT_TARGET}</string>\n")
  endif()
  cmake_path(GET info FILENAME description)
  configure_file("${TESSEL_MODULES_FOLDER}/${description}.in" "${info}" @ONLY)
  if(BUNDLE_TEXTS)
    cmake_path(GET BUNDLE_TEXTS STEM texts)
    add_resource_module("${resources}/${texts}.dll" "${BUNDLE_TEXTS}")
    add_custom_target(${name}_texts DEPENDS "${resources}/${texts}.dll")
    add_dependencies(${name} ${name}_texts)
  endif()
  if(BUNDLE_RESOURCES)
    cmake_path(ABSOLUTE_PATH BUNDLE_RESOURCES)
    add_custom_target(${name}_resources
      COMMAND ${CMAKE_COMMAND} -E copy_directory "${BUNDLE_RESOURCES}" "${resources}"
      VERBATIM)
    add_dependencies(${name} ${name}_resources)
  endif()
endfunction()

function(tessel_add_lisp name)
  cmake_parse_arguments(PARSE_ARGV 1 LISP "" "FOLDER" "")
  list(LENGTH LISP_UNPARSED_ARGUMENTS count)
  if(NOT count EQUAL 1)
    message(FATAL_ERROR "tessel_add_lisp(${name}) takes one source file")
  endif()
  tessel_take_folder(LISP_FOLDER)
  cmake_path(ABSOLUTE_PATH LISP_UNPARSED_ARGUMENTS OUTPUT_VARIABLE source)
  set(compiled "${LISP_FOLDER}/${name}.qbc")
  file(MAKE_DIRECTORY "${LISP_FOLDER}")
  add_custom_command(OUTPUT "${compiled}"
    COMMAND Tessel::compiler "${source}" -o "${compiled}"
    DEPENDS "${source}" Tessel::compiler
    COMMENT "Compiling ${LISP_UNPARSED_ARGUMENTS}"
    VERBATIM)
  add_custom_target(${name} ALL DEPENDS "${compiled}")
  set_target_properties(${name} PROPERTIES TESSEL_PATH "${compiled}")
endfunction()

function(tessel_add_test name)
  cmake_parse_arguments(PARSE_ARGV 1 TEST "" "MODULE" "TYPES;SHOWS")
  if(NOT TEST_MODULE OR NOT TEST_SHOWS OR TEST_UNPARSED_ARGUMENTS)
    message(FATAL_ERROR "tessel_add_test(${name}) takes MODULE module [TYPES command...] SHOWS text...")
  endif()
  get_target_property(path ${TEST_MODULE} TESSEL_PATH)
  add_test(NAME ${name} COMMAND ${CMAKE_COMMAND} "-DPROGRAM=$<TARGET_FILE:Tessel::program>" "-DMODULE=${path}"
    "-DPROFILE=${CMAKE_CURRENT_BINARY_DIR}/${name}.profile" "-DTYPES=${TEST_TYPES}" "-DSHOWS=${TEST_SHOWS}"
    -P "${TESSEL_MODULES_FOLDER}/TesselTest.cmake")
endfunction()

# What both are made of. All that the host offers has to resolve now, so that a misspelt name is found here and not when
# somebody loads the module.
function(tessel_add_library name file folder)
  if(NOT ARGN)
    message(FATAL_ERROR "The module ${name} is given no source files")
  endif()
  add_library(${name} MODULE ${ARGN} "${TESSEL_MODULES_FOLDER}/TesselSdkVersion.cpp")
  target_link_libraries(${name} PRIVATE Tessel::host)
  # Neither the place nor the name is the configuration's: a file is found by its name, and a bundle's in the bundle.
  set_target_properties(${name} PROPERTIES
    PREFIX "" SUFFIX "" OUTPUT_NAME "${file}"
    DEBUG_POSTFIX "" RELEASE_POSTFIX "" RELWITHDEBINFO_POSTFIX "" MINSIZEREL_POSTFIX ""
    LIBRARY_OUTPUT_DIRECTORY "$<1:${folder}>"
    CXX_VISIBILITY_PRESET hidden VISIBILITY_INLINES_HIDDEN ON
    LINK_DEPENDS "${TESSEL_MODULES_FOLDER}/exports.map")
  if(APPLE)
    target_link_options(${name} PRIVATE -Wl,-exported_symbol,_tsrxEntryPoint)
  else()
    target_link_options(${name} PRIVATE
      "-Wl,--version-script=${TESSEL_MODULES_FOLDER}/exports.map" -Wl,-z,defs)
  endif()
endfunction()
