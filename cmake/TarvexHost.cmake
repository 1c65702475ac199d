# What a host application uses to build itself from its sources and its resource script:
#
#   tvx_add_application(board SOURCES BoardApp.cpp BoardView.cpp RESOURCES board.rc)
#
# Works inside this build and, through find_package(Tarvex), outside of it.
set(TVX_HOST_DIR "${CMAKE_CURRENT_LIST_DIR}" CACHE INTERNAL "Where the files of the host functions are")

find_program(TVX_LLVM_RC NAMES llvm-rc llvm-rc-19 llvm-rc-18 llvm-rc-17 llvm-rc-16 llvm-rc-15 llvm-rc-14
  DOC "Compiler of resource scripts (Debian: package llvm)" REQUIRED)

# tvx_compile_resources(TARGET SCRIPT [KEEP_LINKED]): compiles a resource script as it is into the program or shared library TARGET,
# whose resources it becomes when the file is loaded. Include folders and definitions are those of the target; a change
# of any included file or picture compiles it again. To be called in the folder that makes TARGET. docs/resources.md
# tells what scripts may contain.
# KEEP_LINKED is for a shared library of which programs may call nothing: each program that links it gets a reference to
# it, without which --as-needed drops it. (An undefined symbol on the linker's command line does not count.)
function(tvx_compile_resources target script)
  cmake_parse_arguments(PARSE_ARGV 2 ARG "KEEP_LINKED" "" "")
  cmake_path(ABSOLUTE_PATH script NORMALIZE)
  cmake_path(GET script STEM stem)
  string(MAKE_C_IDENTIFIER "tvx_resources_${target}_${stem}" TVX_RESOURCE_SYMBOL)
  set(folder "${CMAKE_CURRENT_BINARY_DIR}/${target}.resources")
  file(MAKE_DIRECTORY "${folder}")
  set(TVX_RESOURCE_SCRIPT "${stem}.rc")
  set(TVX_RESOURCE_DATA "${folder}/${stem}.res")
  set(module "${folder}/${stem}.cpp")

  set(includes "$<TARGET_PROPERTY:${target},INCLUDE_DIRECTORIES>")
  set(definitions "$<TARGET_PROPERTY:${target},COMPILE_DEFINITIONS>")
  add_custom_command(
    OUTPUT "${TVX_RESOURCE_DATA}"
    COMMAND Tarvex::ResourceCompiler
      "$<$<BOOL:${includes}>:-I;$<JOIN:${includes},;-I;>>"
      "$<$<BOOL:${definitions}>:-D;$<JOIN:${definitions},;-D;>>"
      "$<$<CONFIG:Debug>:-D;_DEBUG>"
      --depfile "${TVX_RESOURCE_DATA}.d"
      --cxx "${CMAKE_CXX_COMPILER}"
      --rc "${TVX_LLVM_RC}"
      "${script}" "${TVX_RESOURCE_DATA}"
    MAIN_DEPENDENCY "${script}"
    DEPFILE "${TVX_RESOURCE_DATA}.d"
    COMMENT "Compiling resources ${stem}.rc of ${target}"
    COMMAND_EXPAND_LISTS
    VERBATIM)
  configure_file("${TVX_HOST_DIR}/ResourceModule.cpp.in" "${module}" @ONLY)
  set_source_files_properties("${module}" PROPERTIES OBJECT_DEPENDS "${TVX_RESOURCE_DATA}")
  target_sources(${target} PRIVATE "${module}")

  if(ARG_KEEP_LINKED)
    configure_file("${TVX_HOST_DIR}/ResourceReference.cpp.in" "${folder}/${stem}.reference.cpp" @ONLY)
    set(is_program "$<STREQUAL:$<TARGET_PROPERTY:TYPE>,EXECUTABLE>")
    target_sources(${target} INTERFACE "$<BUILD_INTERFACE:$<${is_program}:${folder}/${stem}.reference.cpp>>")
  endif()
endfunction()

# tvx_add_application(NAME SOURCES file... [RESOURCES script.rc] [LIBRARIES library...]): a program of the family. Its
# sources hold one global application object and no main; the layer's entry point runs the object.
function(tvx_add_application name)
  cmake_parse_arguments(PARSE_ARGV 1 ARG "" "RESOURCES" "SOURCES;LIBRARIES")
  if(ARG_UNPARSED_ARGUMENTS OR NOT ARG_SOURCES)
    message(FATAL_ERROR "tvx_add_application(${name}): use SOURCES file... [RESOURCES script] [LIBRARIES library...]")
  endif()
  add_executable(${name} ${ARG_SOURCES})
  target_include_directories(${name} PRIVATE "${CMAKE_CURRENT_SOURCE_DIR}")
  target_link_libraries(${name} PRIVATE $<TARGET_NAME_IF_EXISTS:Tarvex::Main> Tarvex::GuiUtilities ${ARG_LIBRARIES})
  if(ARG_RESOURCES)
    tvx_compile_resources(${name} "${ARG_RESOURCES}")
  endif()
endfunction()
