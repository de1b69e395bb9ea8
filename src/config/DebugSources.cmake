# The debug configuration, its XML reader and the log writers.
target_sources(ovo_core PRIVATE
  ${CMAKE_CURRENT_LIST_DIR}/xml_node.cpp
  ${CMAKE_CURRENT_LIST_DIR}/xml_path_query.cpp
  ${CMAKE_CURRENT_LIST_DIR}/xml_tokenizer.cpp
  ${CMAKE_CURRENT_LIST_DIR}/xml_reader.cpp
  ${CMAKE_CURRENT_LIST_DIR}/debug_log.cpp
  ${CMAKE_CURRENT_LIST_DIR}/debug_config.cpp)
