# What a host application uses to build itself from its sources and its resource script:
#
#   tvx_add_application(board SOURCES BoardApp.cpp BoardView.cpp RESOURCES board.rc TRANSLATIONS DEU deu/board.rc)
#
# Works inside this build and, through find_package(Tarvex), outside of it.
set(TVX_HOST_DIR "${CMAKE_CURRENT_LIST_DIR}" CACHE INTERNAL "Where the files of the host functions are")

find_program(TVX_LLVM_RC NAMES llvm-rc llvm-rc-19 llvm-rc-18 llvm-rc-17 llvm-rc-16 llvm-rc-15 llvm-rc-14
  DOC "Compiler of resource scripts (Debian: package llvm)" REQUIRED)

# The command that compiles SCRIPT into DATA with the include folders and definitions of TARGET.
function(_tvx_compile_script target script data)
  cmake_path(GET script FILENAME name)
  set(includes "$<TARGET_PROPERTY:${target},INCLUDE_DIRECTORIES>")
  set(definitions "$<TARGET_PROPERTY:${target},COMPILE_DEFINITIONS>")
  add_custom_command(
    OUTPUT "${data}"
    COMMAND Tarvex::ResourceCompiler
      "$<$<BOOL:${includes}>:-I;$<JOIN:${includes},;-I;>>"
      "$<$<BOOL:${definitions}>:-D;$<JOIN:${definitions},;-D;>>"
      "$<$<CONFIG:Debug>:-D;_DEBUG>"
      --depfile "${data}.d"
      --cxx "${CMAKE_CXX_COMPILER}"
      --rc "${TVX_LLVM_RC}"
      "${script}" "${data}"
    MAIN_DEPENDENCY "${script}"
    DEPFILE "${data}.d"
    COMMENT "Compiling resources ${name} of ${target}"
    COMMAND_EXPAND_LISTS
    VERBATIM)
endfunction()

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

  _tvx_compile_script(${target} "${script}" "${TVX_RESOURCE_DATA}")
  configure_file("${TVX_HOST_DIR}/ResourceModule.cpp.in" "${module}" @ONLY)
  set_source_files_properties("${module}" PROPERTIES OBJECT_DEPENDS "${TVX_RESOURCE_DATA}")
  target_sources(${target} PRIVATE "${module}")

  if(ARG_KEEP_LINKED)
    configure_file("${TVX_HOST_DIR}/ResourceReference.cpp.in" "${folder}/${stem}.reference.cpp" @ONLY)
    set(is_program "$<STREQUAL:$<TARGET_PROPERTY:TYPE>,EXECUTABLE>")
    target_sources(${target} INTERFACE "$<BUILD_INTERFACE:$<${is_program}:${folder}/${stem}.reference.cpp>>")
  endif()
endfunction()

# tvx_add_translations(TARGET LANGUAGE SCRIPT [LANGUAGE SCRIPT]...): builds a resource library of the program or shared
# library TARGET for each language, and places it beside TARGET, where it is found at run time: "board.DEU" for the
# program "board", "GuiUtilities.DEU" for libGuiUtilities.so. LANGUAGE is the platform's abbreviation in three letters.
# To be called in the folder that makes TARGET. docs/languages.md tells what a translated script holds.
#
#   tvx_add_translations(board DEU res/deu/Board.rc JPN res/jpn/Board.rc)
function(tvx_add_translations target)
  set(arguments ${ARGN})
  get_target_property(type ${target} TYPE)
  if(type STREQUAL EXECUTABLE)
    get_target_property(folder ${target} RUNTIME_OUTPUT_DIRECTORY)
  else()
    get_target_property(folder ${target} LIBRARY_OUTPUT_DIRECTORY)
  endif()
  if(NOT folder)
    set(folder "${CMAKE_CURRENT_BINARY_DIR}")
  endif()
  get_target_property(base ${target} OUTPUT_NAME)
  if(NOT base)
    set(base ${target})
  endif()
  file(MAKE_DIRECTORY "${CMAKE_CURRENT_BINARY_DIR}/${target}.resources")
  set(libraries)
  while(arguments)
    list(POP_FRONT arguments language script)
    if(NOT language MATCHES "^[A-Z][A-Z][A-Z]$" OR NOT script)
      message(FATAL_ERROR "tvx_add_translations(${target}): use LANGUAGE SCRIPT pairs such as DEU res/deu/${base}.rc")
    endif()
    cmake_path(ABSOLUTE_PATH script NORMALIZE)
    set(data "${CMAKE_CURRENT_BINARY_DIR}/${target}.resources/${base}.${language}.res")
    _tvx_compile_script(${target} "${script}" "${data}")
    add_custom_command(
      OUTPUT "${folder}/${base}.${language}"
      COMMAND "${CMAKE_COMMAND}" -E copy "${data}" "${folder}/${base}.${language}"
      DEPENDS "${data}"
      COMMENT "Placing ${base}.${language} beside ${target}"
      VERBATIM)
    list(APPEND libraries "${folder}/${base}.${language}")
  endwhile()
  add_custom_target(${target}-translations DEPENDS ${libraries})
  add_dependencies(${target} ${target}-translations)
endfunction()

# Makes TARGET find headers that its sources name in another case than the file's, or with backslashes. Sources, headers
# and the resource script are looked through before they are compiled, and again when one of them changes.
function(_tvx_find_headers target)
  set(folder "${CMAKE_CURRENT_BINARY_DIR}/${target}.includes")
  set(includes "$<TARGET_PROPERTY:${target},INCLUDE_DIRECTORIES>")
  set(systems ${CMAKE_CXX_IMPLICIT_INCLUDE_DIRECTORIES})
  list(TRANSFORM systems PREPEND "--system;")
  set(sources)
  foreach(source IN LISTS ARGN)
    cmake_path(ABSOLUTE_PATH source NORMALIZE)
    list(APPEND sources "${source}")
  endforeach()
  add_custom_command(
    OUTPUT "${folder}.stamp"
    COMMAND Tarvex::IncludeFinder
      --output "${folder}" --stamp "${folder}.stamp" --depfile "${folder}.d"
      "$<$<BOOL:${includes}>:-I;$<JOIN:${includes},;-I;>>"
      ${systems}
      ${sources}
    DEPENDS ${sources} Tarvex::IncludeFinder
    DEPFILE "${folder}.d"
    COMMENT "Looking for the headers of ${target}"
    COMMAND_EXPAND_LISTS
    VERBATIM)
  add_custom_target(${target}-includes DEPENDS "${folder}.stamp")
  add_dependencies(${target} ${target}-includes)
  target_include_directories(${target} PRIVATE "${folder}/1/2/3/4")
endfunction()

# tvx_add_application(NAME SOURCES file... [RESOURCES script.rc] [TRANSLATIONS language script...] [LIBRARIES library...]):
# a program of the family. Its sources hold one global application object and no main; the layer's entry point runs the
# object. TRANSLATIONS are those of tvx_add_translations.
# Sources of old applications compile as they are: docs/moving-an-application.md tells what is done for them.
function(tvx_add_application name)
  cmake_parse_arguments(PARSE_ARGV 1 ARG "" "RESOURCES" "SOURCES;TRANSLATIONS;LIBRARIES")
  if(ARG_UNPARSED_ARGUMENTS OR NOT ARG_SOURCES)
    message(FATAL_ERROR "tvx_add_application(${name}): use SOURCES file... [RESOURCES script] "
      "[TRANSLATIONS language script...] [LIBRARIES library...]")
  endif()
  add_executable(${name} ${ARG_SOURCES})
  target_include_directories(${name} PRIVATE "${CMAKE_CURRENT_SOURCE_DIR}")
  target_link_libraries(${name} PRIVATE $<TARGET_NAME_IF_EXISTS:Tarvex::Main> Tarvex::GuiUtilities ${ARG_LIBRARIES})
  _tvx_find_headers(${name} ${ARG_SOURCES} ${ARG_RESOURCES})
  # Old names of library functions and types; handlers in message maps without "&", which clang cannot read.
  target_compile_options(${name} PRIVATE
    "$<$<COMPILE_LANGUAGE:CXX>:SHELL:-include compatibility.h>"
    $<$<COMPILE_LANG_AND_ID:CXX,GNU>:-fms-extensions>)
  if(ARG_RESOURCES)
    tvx_compile_resources(${name} "${ARG_RESOURCES}")
  endif()
  if(ARG_TRANSLATIONS)
    tvx_add_translations(${name} ${ARG_TRANSLATIONS})
  endif()
endfunction()
