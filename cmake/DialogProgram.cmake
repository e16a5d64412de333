# make_dialog_program(TARGET NAME)
# Lays out a program that holds the dialogs as an application NAME.app, whose folder is to them what the bundle is to
# those of the product: their layouts and texts are found in it.
function(make_dialog_program target name)
  set(app "${CMAKE_CURRENT_BINARY_DIR}/${name}.app")
  set_target_properties(${target} PROPERTIES
    RUNTIME_OUTPUT_DIRECTORY "${app}" OUTPUT_NAME ${name} LINKER_LANGUAGE OBJCXX)
  foreach(resource modrig/resources/Modrig.xib modrig/resources/ModrigStartupSuit.xib
                   modrig/resources/en.lproj/Localizable.strings host/ui/resources/en.lproj/FilePanel.strings)
    set(source "${CMAKE_SOURCE_DIR}/${resource}")
    string(REGEX REPLACE "^.*/resources/" "" resource "${resource}")
    set(place "${app}/Resources/${resource}")
    add_custom_command(
      OUTPUT "${place}"
      COMMAND ${CMAKE_COMMAND} -E copy "${source}" "${place}"
      DEPENDS "${source}"
      VERBATIM)
    target_sources(${target} PRIVATE "${place}")
  endforeach()
  if(NOT APPLE)
    foreach(theme Tessel TesselDark) # the host's look, which is measured and timed as well
      add_custom_command(
        OUTPUT "${app}/Resources/${theme}.theme"
        COMMAND ${CMAKE_COMMAND} -E create_symlink
          "${TESSEL_APP_RESOURCES}/${theme}.theme" "${app}/Resources/${theme}.theme"
        VERBATIM)
      target_sources(${target} PRIVATE "${app}/Resources/${theme}.theme")
    endforeach()
    add_dependencies(${target} tessel_theme_light tessel_theme_dark)
  endif()
endfunction()
