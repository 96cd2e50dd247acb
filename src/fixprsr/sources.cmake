# Sources of this area, added to the plug-in's objects.
target_sources(kxvfix_objects PRIVATE
  ${CMAKE_CURRENT_LIST_DIR}/decimal.cpp
  ${CMAKE_CURRENT_LIST_DIR}/fieldreport.cpp
  ${CMAKE_CURRENT_LIST_DIR}/islike.cpp
  ${CMAKE_CURRENT_LIST_DIR}/parsefixfile.cpp
  ${CMAKE_CURRENT_LIST_DIR}/parsegroup.cpp
  ${CMAKE_CURRENT_LIST_DIR}/requiredcheck.cpp
  ${CMAKE_CURRENT_LIST_DIR}/tagindex.cpp)
