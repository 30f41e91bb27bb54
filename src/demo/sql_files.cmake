# Builds the SQL files of the company database into zebtell_demo.
set(database_dir ${PROJECT_SOURCE_DIR}/database)
foreach(script sqlite/schema sqlite/views sqlserver/schema sqlserver/links sqlserver/views)
    string(REPLACE / _ name ${script})
    file(READ ${database_dir}/${script}.sql ZEBTELL_${name}_SQL)
    set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${database_dir}/${script}.sql)
endforeach()
configure_file(${CMAKE_CURRENT_LIST_DIR}/sql_files.cpp.in
               ${CMAKE_CURRENT_BINARY_DIR}/demo/sql_files.cpp @ONLY)
target_sources(zebtell_demo PRIVATE ${CMAKE_CURRENT_BINARY_DIR}/demo/sql_files.cpp)
