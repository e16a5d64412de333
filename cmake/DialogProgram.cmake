# make_dialog_program(TARGET NAME)
# Lays out a program that holds the dialogs as an application NAME.app, whose folder is to them what the bundle is to
# those of the product: their layouts and texts are found in it.
function(make_dialog_program target name)
  set(app "${CMAKE_CURRENT_BINARY_DIR}/${name}.app")
  set_target_properties(${target} PROPERTIES
    RUNTIME_OUTPUT_DIRECTORY "${app}" OUTPUT_NAME ${name} LINKER_LANGUAGE OBJCXX)
  set(resources "${CMAKE_SOURCE_DIR}/modrig/resources")
  copy_strings(texts "${CMAKE_SOURCE_DIR}/host/ui/resources" Windows "${app}/Resources")
  copy_strings(texts "${resources}" Localizable "${app}/Resources")
  translate_layout(texts "${resources}" Modrig "${app}/Resources")
  translate_layout(texts "${resources}" ModrigStartupSuit "${app}/Resources")
  target_sources(${target} PRIVATE ${texts})
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
