# What Windows shows of a program and how it treats it: icon, version, manifest. Wants the target's name in `program`.
set(description "RDS and stereo generator control")
set(manifest ${CMAKE_CURRENT_LIST_DIR}/program.manifest)
set(icon ${CMAKE_CURRENT_BINARY_DIR}/${program}.ico)
set(pictures 16 24 32 48 64 256)  # what the system asks for
list(TRANSFORM pictures REPLACE "(.+)" "${PROJECT_SOURCE_DIR}/packaging/icons/kdx-rds-\\1.png")
execute_process(COMMAND ${CMAKE_CURRENT_LIST_DIR}/make-icon ${icon} ${pictures} COMMAND_ERROR_IS_FATAL ANY)
set(rc ${CMAKE_CURRENT_BINARY_DIR}/${program}.rc)
configure_file(${CMAKE_CURRENT_LIST_DIR}/program.rc.in ${rc} @ONLY)
set_source_files_properties(${rc} PROPERTIES OBJECT_DEPENDS "${manifest};${icon}")
target_sources(${program} PRIVATE ${rc})
