# Texts of windows in every language: one folder a language below a folder of resources, as both platforms have it.
set(LANGUAGES en de) # the first is that of the sources

# copy_strings(OUTPUTS RESOURCES TABLE PLACE): RESOURCES/<language>.lproj/TABLE.strings below the place. Appends the files
# to the list named OUTPUTS.
function(copy_strings outputs resources table place)
  foreach(language IN LISTS LANGUAGES)
    set(source "${resources}/${language}.lproj/${table}.strings")
    set(copy "${place}/${language}.lproj/${table}.strings")
    add_custom_command(
      OUTPUT "${copy}"
      COMMAND ${CMAKE_COMMAND} "-DFROM=${source}" "-DTO=${copy}" -P "${CMAKE_SOURCE_DIR}/cmake/CopyStrings.cmake"
      DEPENDS "${source}" "${CMAKE_SOURCE_DIR}/cmake/CopyStrings.cmake"
      COMMENT "Copying ${table}.strings (${language})"
      VERBATIM)
    list(APPEND ${outputs} "${copy}")
  endforeach()
  set(${outputs} "${${outputs}}" PARENT_SCOPE)
endfunction()

# AppKit reads only layouts that Apple's tools have compiled; GNUstep reads them as they are.
if(APPLE)
  find_program(IBTOOL ibtool REQUIRED)
endif()

# compile_layout(OUTPUTS XIB NIB): for AppKit. Appends the file to the list named OUTPUTS.
function(compile_layout outputs xib nib)
  add_custom_command(
    OUTPUT "${nib}"
    COMMAND "${IBTOOL}" --errors --warnings --notices --output-format human-readable-text
      --minimum-deployment-target ${CMAKE_OSX_DEPLOYMENT_TARGET} --target-device mac --compile "${nib}" "${xib}"
    DEPENDS "${xib}"
    COMMENT "Compiling ${nib}"
    VERBATIM)
  set(${outputs} "${${outputs}};${nib}" PARENT_SCOPE)
endfunction()

# translate_layout(OUTPUTS RESOURCES LAYOUT PLACE): the windows of RESOURCES/LAYOUT.xib in every language. Their texts in
# other languages than the first stand in RESOURCES/<language>.lproj/LAYOUT.strings.
function(translate_layout outputs resources layout place)
  set(source "${resources}/${layout}.xib")
  file(REMOVE "${place}/${layout}.xib") # of a build from before there were languages: it would be found first
  foreach(language IN LISTS LANGUAGES)
    set(laid_out "${place}/${language}.lproj")
    if(APPLE)
      file(MAKE_DIRECTORY "${laid_out}")
      set(laid_out "${CMAKE_CURRENT_BINARY_DIR}/layouts/${language}.lproj")
    endif()
    set(output "${laid_out}/${layout}.xib")
    set(strings "${resources}/${language}.lproj/${layout}.strings")
    set(make ${CMAKE_COMMAND} "-DLAYOUT=${source}" "-DSTRINGS=${strings}" "-DOUTPUT=${output}"
        -P "${CMAKE_SOURCE_DIR}/cmake/TranslateLayout.cmake")
    set(read "${strings}" "${CMAKE_SOURCE_DIR}/cmake/TranslateLayout.cmake")
    if(NOT EXISTS "${strings}")
      file(MAKE_DIRECTORY "${laid_out}")
      set(make ${CMAKE_COMMAND} -E copy "${source}" "${output}")
      set(read "")
    endif()
    add_custom_command(
      OUTPUT "${output}"
      COMMAND ${make}
      DEPENDS "${source}" ${read}
      COMMENT "Laying out ${layout} (${language})"
      VERBATIM)
    if(APPLE)
      compile_layout(${outputs} "${output}" "${place}/${language}.lproj/${layout}.nib")
    else()
      list(APPEND ${outputs} "${output}")
    endif()
  endforeach()
  set(${outputs} "${${outputs}}" PARENT_SCOPE)
endfunction()
