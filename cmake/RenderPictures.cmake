# Pictures from drawings: PNG files for screens of one, two and three pixels a point.
find_program(RSVG_CONVERT rsvg-convert REQUIRED) # Debian package librsvg2-bin, Homebrew's librsvg

# render_icon(OUTPUT STYLE DRAWING): OUTPUT, a file of icons (.icns) of all the sizes in which macOS shows one.
function(render_icon output style drawing)
  find_program(ICONUTIL iconutil REQUIRED)
  cmake_path(GET drawing STEM name)
  set(iconset "${CMAKE_CURRENT_BINARY_DIR}/${name}.iconset")
  set(render COMMAND ${CMAKE_COMMAND} -E make_directory "${iconset}")
  foreach(size 16 32 128 256 512)
    math(EXPR twice "2 * ${size}")
    foreach(picture "${size}/icon_${size}x${size}" "${twice}/icon_${size}x${size}@2x")
      cmake_path(GET picture PARENT_PATH pixels)
      cmake_path(GET picture FILENAME file)
      list(APPEND render COMMAND "${RSVG_CONVERT}" --stylesheet "${style}" --width ${pixels} --height ${pixels}
        --output "${iconset}/${file}.png" "${drawing}")
    endforeach()
  endforeach()
  add_custom_command(
    OUTPUT "${output}"
    ${render}
    COMMAND "${ICONUTIL}" --convert icns --output "${output}" "${iconset}"
    DEPENDS "${drawing}" "${style}"
    COMMENT "Rendering ${name} as icons"
    VERBATIM)
endfunction()

# render_pictures(OUTPUTS STYLE FOLDER DRAWING...): into the folder, in the colours of a style sheet. Appends
# the files to the list named OUTPUTS.
function(render_pictures outputs style folder)
  foreach(drawing IN LISTS ARGN)
    cmake_path(GET drawing STEM name)
    set(once "${folder}/${name}.png")
    set(twice "${folder}/${name}@2x.png")
    set(thrice "${folder}/${name}@3x.png")
    set(render "${RSVG_CONVERT}" --stylesheet "${style}" "${drawing}")
    add_custom_command(
      OUTPUT "${once}" "${twice}" "${thrice}"
      COMMAND ${CMAKE_COMMAND} -E make_directory "${folder}"
      COMMAND ${render} --zoom 1 --output "${once}"
      COMMAND ${render} --zoom 2 --output "${twice}"
      COMMAND ${render} --zoom 3 --output "${thrice}"
      DEPENDS "${drawing}" "${style}"
      COMMENT "Rendering ${name}"
      VERBATIM)
    list(APPEND ${outputs} "${once}" "${twice}" "${thrice}")
  endforeach()
  set(${outputs} "${${outputs}}" PARENT_SCOPE)
endfunction()
