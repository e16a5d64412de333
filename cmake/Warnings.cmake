# Warnings are errors in our own code: targets link to `project_warnings`. Objective-C++ answers messages whose
# parameters the toolkit decides, so that many of them go unused.
add_library(project_warnings INTERFACE)
target_compile_options(project_warnings INTERFACE
  $<$<COMPILE_LANGUAGE:CXX>:-Wall;-Wextra;-Wpedantic;-Wshadow;-Wconversion;-Wnon-virtual-dtor;-Wold-style-cast;-Werror>
  $<$<COMPILE_LANGUAGE:OBJCXX>:-Wall;-Wextra;-Wno-unused-parameter;-Werror>
  $<$<COMPILE_LANGUAGE:C>:-Wall;-Wextra;-Wpedantic;-Werror>)
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND CMAKE_CXX_COMPILER_VERSION VERSION_LESS 13)
  # GCC 12 sees overlapping copies inside std::string's operator+ where there are none (fixed in GCC 13), and where it
  # optimizes, moves of a std::wstring that are longer than the string's own buffer.
  target_compile_options(project_warnings INTERFACE -Wno-restrict $<$<CONFIG:Release>:-Wno-attribute-warning>)
endif()
