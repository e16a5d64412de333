# make_dialog_program(TARGET NAME)
# Lays out a program that holds the dialogs as an application NAME.app, whose folder is to them what the bundle is to
# those of the product: their layouts and texts are found in it.
function(make_dialog_program target name)
  set(app "${CMAKE_CURRENT_BINARY_DIR}/${name}.app")
  set_target_properties(${target} PROPERTIES
    RUNTIME_OUTPUT_DIRECTORY "${app}" OUTPUT_NAME ${name} LINKER_LANGUAGE OBJCXX)
  foreach(resource Modrig.xib ModrigStartupSuit.xib en.lproj/Localizable.strings)
    set(source "${CMAKE_SOURCE_DIR}/resources/${resource}")
    set(place "${app}/Resources/${resource}")
    add_custom_command(
      OUTPUT "${place}"
      COMMAND ${CMAKE_COMMAND} -E copy "${source}" "${place}"
      DEPENDS "${source}"
      VERBATIM)
    target_sources(${target} PRIVATE "${place}")
  endforeach()
endfunction()
