# Builds the SQL files of the company database into zebtell_demo.
set(database_dir ${PROJECT_SOURCE_DIR}/database/sqlite)
file(READ ${database_dir}/schema.sql ZEBTELL_SCHEMA_SQL)
file(READ ${database_dir}/views.sql ZEBTELL_VIEWS_SQL)
set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS
             ${database_dir}/schema.sql ${database_dir}/views.sql)
configure_file(${CMAKE_CURRENT_LIST_DIR}/sql_files.cpp.in
               ${CMAKE_CURRENT_BINARY_DIR}/demo/sql_files.cpp @ONLY)
target_sources(zebtell_demo PRIVATE ${CMAKE_CURRENT_BINARY_DIR}/demo/sql_files.cpp)
