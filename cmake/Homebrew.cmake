# On macOS libraries and tools come from Homebrew, which keeps some out of everybody's way, in folders of their own.
find_program(BREW brew)
if(BREW)
  execute_process(COMMAND "${BREW}" --prefix OUTPUT_VARIABLE homebrew OUTPUT_STRIP_TRAILING_WHITESPACE)
  file(GLOB apart "${homebrew}/opt/icu4c*" "${homebrew}/opt/openssl@3" "${homebrew}/opt/sqlite" "${homebrew}/opt/libedit"
    "${homebrew}/opt/llvm" "${homebrew}/opt/lld")
  list(APPEND CMAKE_PREFIX_PATH "${homebrew}" ${apart})
endif()
