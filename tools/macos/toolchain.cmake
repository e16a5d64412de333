# Compiles and links for macOS on Linux: with the machine's clang and lld, and what stands for Apple's SDK.
# MACOS_SDK and MACOS_PROCESSOR are given on the command line.
set(CMAKE_SYSTEM_NAME Darwin)
set(CMAKE_SYSTEM_PROCESSOR "${MACOS_PROCESSOR}")
list(APPEND CMAKE_TRY_COMPILE_PLATFORM_VARIABLES MACOS_SDK MACOS_PROCESSOR)
set(CMAKE_OSX_SYSROOT "${MACOS_SDK}")
set(CMAKE_OSX_ARCHITECTURES "${MACOS_PROCESSOR}" CACHE STRING "" FORCE)

foreach(language C CXX OBJC OBJCXX)
  set(CMAKE_${language}_COMPILER_TARGET "${MACOS_PROCESSOR}-apple-macos")
  # What stands in the configuration of the C++ library as a Mac has it.
  set(CMAKE_${language}_FLAGS_INIT "-D_LIBCPP_ABI_VERSION=1 -D_LIBCPP_ABI_NAMESPACE=__1 -stdlib=libc++ -fuse-ld=lld -Wno-unused-command-line-argument")
endforeach()
find_program(CMAKE_C_COMPILER NAMES clang-14 clang REQUIRED)
find_program(CMAKE_CXX_COMPILER NAMES clang++-14 clang++ REQUIRED)
foreach(tool AR RANLIB NM STRIP OTOOL INSTALL_NAME_TOOL)
  string(TOLOWER "${tool}" name)
  string(REPLACE _ - name "${name}")
  find_program(CMAKE_${tool} NAMES llvm-${name} llvm-${name}-14 REQUIRED)
endforeach()

# What comes with Apple's developer tools and is called by name.
list(PREPEND CMAKE_PROGRAM_PATH "${CMAKE_CURRENT_LIST_DIR}/bin")
set(ENV{PATH} "${CMAKE_CURRENT_LIST_DIR}/bin:$ENV{PATH}") # CMake itself asks one which system this is

# Libraries and headers are found in the SDK alone, programs on this machine.
set(CMAKE_FIND_ROOT_PATH "${MACOS_SDK}")
set(CMAKE_FIND_ROOT_PATH_MODE_PROGRAM NEVER)
set(CMAKE_FIND_ROOT_PATH_MODE_INCLUDE ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_LIBRARY ONLY)
set(CMAKE_FIND_ROOT_PATH_MODE_PACKAGE ONLY)
set(ENV{PKG_CONFIG_LIBDIR} "${MACOS_SDK}/usr/local/lib/pkgconfig")
