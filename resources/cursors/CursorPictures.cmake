# The library's own cursor pictures, included from src/CMakeLists.txt: a small program turns
# the text pictures here into PNGs and a .qrc, rcc compiles them into a source of
# VelmarObjects (registered as "velmar_cursors"; the cursor table calls Q_INIT_RESOURCE).
add_executable(velmar_make_cursor_pictures ${CMAKE_CURRENT_LIST_DIR}/make_cursor_pictures.cpp)
target_link_libraries(velmar_make_cursor_pictures PRIVATE Qt6::Gui)
set_target_properties(velmar_make_cursor_pictures PROPERTIES AUTOMOC OFF AUTORCC OFF)

file(GLOB VELMAR_CURSOR_PICTURES CONFIGURE_DEPENDS ${CMAKE_CURRENT_LIST_DIR}/*.txt)
set(VELMAR_CURSOR_DIR ${CMAKE_CURRENT_BINARY_DIR}/cursor-pictures)
set(VELMAR_CURSOR_SOURCE ${CMAKE_CURRENT_BINARY_DIR}/velmar_cursors.cpp)
add_custom_command(OUTPUT ${VELMAR_CURSOR_SOURCE}
  COMMAND ${CMAKE_COMMAND} -E rm -rf ${VELMAR_CURSOR_DIR}
  COMMAND velmar_make_cursor_pictures ${VELMAR_CURSOR_DIR} ${VELMAR_CURSOR_PICTURES}
  COMMAND $<TARGET_FILE:Qt6::rcc> --name velmar_cursors -o ${VELMAR_CURSOR_SOURCE}
    ${VELMAR_CURSOR_DIR}/velmar_cursors.qrc
  DEPENDS velmar_make_cursor_pictures ${VELMAR_CURSOR_PICTURES}
  COMMENT "Drawing the cursor pictures"
  VERBATIM)
set_source_files_properties(${VELMAR_CURSOR_SOURCE} PROPERTIES SKIP_AUTOGEN ON)
target_sources(VelmarObjects PRIVATE ${VELMAR_CURSOR_SOURCE})
