# What the applications of the family share: each is built with its own copy. Sources and scripts name these files by
# their path from the folder above the samples.
cmake_path(GET CMAKE_CURRENT_LIST_DIR PARENT_PATH familyAbove)
cmake_path(GET familyAbove PARENT_PATH familyAbove)
include_directories("${familyAbove}")
set(familySources
  ${CMAKE_CURRENT_LIST_DIR}/FamilyOptions.cpp
  ${CMAKE_CURRENT_LIST_DIR}/FamilyPages.cpp
  ${CMAKE_CURRENT_LIST_DIR}/KeyDifferences.cpp
  ${CMAKE_CURRENT_LIST_DIR}/PreferencePage.cpp
  ${CMAKE_CURRENT_LIST_DIR}/Preferences.cpp)
