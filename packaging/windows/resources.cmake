# What Windows shows of a program and how it treats it: icon, version, manifest. Wants the target's name in `program`.
set(description "RDS and stereo generator control")
set(manifest ${CMAKE_CURRENT_LIST_DIR}/program.manifest)
set(icon ${CMAKE_CURRENT_BINARY_DIR}/${program}.ico)
set(pictures ${PROJECT_SOURCE_DIR}/src/ui/pictures)
execute_process(COMMAND ${CMAKE_CURRENT_LIST_DIR}/make-icon ${icon}
    ${pictures}/kdx-rds-32.png ${pictures}/kdx-rds-64.png ${pictures}/kdx-rds.png COMMAND_ERROR_IS_FATAL ANY)
set(rc ${CMAKE_CURRENT_BINARY_DIR}/${program}.rc)
configure_file(${CMAKE_CURRENT_LIST_DIR}/program.rc.in ${rc} @ONLY)
set_source_files_properties(${rc} PROPERTIES OBJECT_DEPENDS "${manifest};${icon}")
target_sources(${program} PRIVATE ${rc})
