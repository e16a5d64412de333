# Targets that link to `hardened` are built so that a fault in them is harder to make use of: tables that the linker fills
# are read-only before the first line runs, stacks and the C library's calls are watched, addresses are drawn by lot.
add_library(hardened INTERFACE)
if(NOT APPLE) # there the compiler does all of it by itself
  target_compile_options(hardened INTERFACE -fstack-protector-strong)
  target_link_options(hardened INTERFACE -Wl,-z,relro,-z,now -Wl,-z,noexecstack)
  if(NOT MODRIG_SANITIZE) # the sanitizers watch the same calls in their own way
    # The C library's calls can be watched in optimised code only.
    target_compile_options(hardened INTERFACE $<$<CONFIG:Debug>:-Og> -U_FORTIFY_SOURCE -D_FORTIFY_SOURCE=2)
  endif()
endif()
include(CheckPIESupported)
check_pie_supported(LANGUAGES C CXX)
