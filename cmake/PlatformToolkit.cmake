# `platform_toolkit`: Foundation and AppKit, of Cocoa on macOS and of GNUstep on Linux.
# `platform_foundation`: Foundation alone, for what needs no window.
add_library(platform_foundation INTERFACE)
add_library(platform_toolkit INTERFACE)

# CMake knows these of C++ and not of Objective-C++: without them a library gets no name of its own and
# finds no neighbours.
foreach(flag SHARED_LIBRARY_SONAME_%_FLAG SHARED_LIBRARY_RUNTIME_%_FLAG SHARED_LIBRARY_RUNTIME_%_FLAG_SEP
             EXECUTABLE_RUNTIME_%_FLAG EXECUTABLE_RUNTIME_%_FLAG_SEP)
  string(REPLACE % OBJCXX objcxx_flag CMAKE_${flag})
  string(REPLACE % CXX cxx_flag CMAKE_${flag})
  set(${objcxx_flag} "${${cxx_flag}}")
endforeach()

if(APPLE)
  # Some calls that the system's headers count as out of use are made on purpose, on either system.
  target_compile_options(platform_foundation INTERFACE
    $<$<COMPILE_LANGUAGE:OBJCXX>:-fno-objc-arc;-Wno-deprecated-declarations;-Wundeclared-selector>)
  target_link_libraries(platform_foundation INTERFACE "-framework Foundation")
  target_link_libraries(platform_toolkit INTERFACE platform_foundation "-framework Cocoa" "-framework CoreServices")
  return()
endif()

find_program(GNUSTEP_CONFIG gnustep-config REQUIRED)
function(gnustep_config option result)
  execute_process(COMMAND ${GNUSTEP_CONFIG} ${option} OUTPUT_VARIABLE output
                  OUTPUT_STRIP_TRAILING_WHITESPACE COMMAND_ERROR_IS_FATAL ANY)
  separate_arguments(output UNIX_COMMAND "${output}")
  set(${result} "${output}" PARENT_SCOPE)
endfunction()
gnustep_config(--objc-flags objc_flags)
gnustep_config(--base-libs base_libs)
gnustep_config(--gui-libs gui_libs)
# CMake knows no standard flags for GCC's Objective-C++; the toolkit's headers need the GNU dialect.
list(APPEND objc_flags -std=gnu++20)
# Optimisation, debugging, warnings and dependency files are CMake's to choose; include folders are the system's,
# so that our warnings are about our code only.
list(FILTER objc_flags EXCLUDE REGEX "^(-MMD|-MP|-g|-O[0-9s]|-Wall|-I.*)$")
list(FILTER base_libs EXCLUDE REGEX "^-L/home.*|^-L/root.*")
list(FILTER gui_libs EXCLUDE REGEX "^-L/home.*|^-L/root.*")
find_path(GNUSTEP_INCLUDE Foundation/Foundation.h PATH_SUFFIXES GNUstep REQUIRED)
target_include_directories(platform_foundation SYSTEM INTERFACE ${GNUSTEP_INCLUDE})
target_compile_options(platform_foundation INTERFACE
  $<$<COMPILE_LANGUAGE:OBJCXX>:${objc_flags};-Wno-subobject-linkage;-Wno-deprecated-declarations>)
target_link_libraries(platform_foundation INTERFACE ${base_libs})
target_link_libraries(platform_toolkit INTERFACE platform_foundation ${gui_libs})
