# Sources of this area, added to the plug-in's objects.
target_sources(kxvfix_objects PRIVATE
  ${CMAKE_CURRENT_LIST_DIR}/fpinputsource.cpp
  ${CMAKE_CURRENT_LIST_DIR}/fpinputstream.cpp)
