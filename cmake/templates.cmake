# The default templates as the program finds them, "share/zebtell/templates" beside its own folder:
# the files of templates/ with a catalogue made of each translation.
set(ZEBTELL_TEMPLATES ${PROJECT_BINARY_DIR}/share/zebtell/templates)
file(GLOB_RECURSE template_files CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/templates/*)
find_program(MSGFMT msgfmt REQUIRED)

set(compile_catalogues)
foreach(language en lv)
    set(catalogue ${ZEBTELL_TEMPLATES}/translations/${language})
    list(APPEND compile_catalogues
         COMMAND ${MSGFMT} --check --output-file=${catalogue}.mo ${catalogue}.po)
endforeach()
set(stamp ${PROJECT_BINARY_DIR}/templates.stamp)
add_custom_command(
    OUTPUT ${stamp}
    COMMAND ${CMAKE_COMMAND} -E rm -rf ${ZEBTELL_TEMPLATES}
    COMMAND ${CMAKE_COMMAND} -E copy_directory ${PROJECT_SOURCE_DIR}/templates ${ZEBTELL_TEMPLATES}
    ${compile_catalogues}
    COMMAND ${CMAKE_COMMAND} -E touch ${stamp}
    DEPENDS ${template_files} VERBATIM)
add_custom_target(zebtell_templates ALL DEPENDS ${stamp})
install(DIRECTORY ${ZEBTELL_TEMPLATES} DESTINATION share/zebtell)
