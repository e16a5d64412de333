find_program(GZIP gzip REQUIRED)

# compress(FILE NAME): into a file of that name in the current build folder, the same bytes each time.
function(compress file name)
  set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS "${file}")
  execute_process(COMMAND ${GZIP} -9nc "${file}" OUTPUT_FILE "${CMAKE_CURRENT_BINARY_DIR}/${name}"
                  COMMAND_ERROR_IS_FATAL ANY)
endfunction()
