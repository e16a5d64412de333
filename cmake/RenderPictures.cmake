# Pictures from drawings: PNG files for screens of one, two and three pixels a point.
find_program(RSVG_CONVERT rsvg-convert REQUIRED) # Debian package librsvg2-bin

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
