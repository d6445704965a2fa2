# velmar_add_classic_executable(name SOURCES file.c ... [RESOURCES file.rsrc] [NO_PREFIX_HEADER])
#
# Builds a classic C program unchanged against the classic headers and Velmar::Classic:
# - C sources are compiled in a lenient classic dialect (implicit int, implicit declarations,
#   functions that return nothing, four-character constants, pointer mix-ups as warnings);
# - with clang, "\p" Pascal-string literals work (-fpascal-strings); GCC has no such option,
#   so a source that writes "\p" stops the configuration with a message saying so;
# - every source sees the umbrella header ClassicToolbox.h first, as with the old compilers
#   that included everything by default (NO_PREFIX_HEADER turns that off);
# - the resource file is copied beside the program as <name>.rsrc, where the program finds it
#   at start.
#
# Included at file scope (by the project, or by find_package(Velmar)): it enables C, choosing
# clang when C is not enabled yet and clang is installed (VELMAR_CLASSIC_C_COMPILER names
# another compiler).
include_guard(GLOBAL)

get_property(_velmar_languages GLOBAL PROPERTY ENABLED_LANGUAGES)
if(NOT "C" IN_LIST _velmar_languages)
  if(NOT CMAKE_C_COMPILER AND NOT DEFINED ENV{CC})
    find_program(VELMAR_CLASSIC_C_COMPILER NAMES clang clang-16 clang-15 clang-14)
    if(VELMAR_CLASSIC_C_COMPILER)
      set(CMAKE_C_COMPILER "${VELMAR_CLASSIC_C_COMPILER}")
    endif()
  endif()
  enable_language(C)
endif()

function(velmar_add_classic_executable name)
  cmake_parse_arguments(PARSE_ARGV 1 ARG "NO_PREFIX_HEADER" "" "SOURCES;RESOURCES")
  if(NOT ARG_SOURCES)
    message(FATAL_ERROR "velmar_add_classic_executable(${name}): no SOURCES given")
  endif()
  set(clang OFF)
  if(CMAKE_C_COMPILER_ID MATCHES "Clang")
    set(clang ON)
  endif()
  if(NOT clang)
    foreach(source IN LISTS ARG_SOURCES)
      get_filename_component(path "${source}" ABSOLUTE)
      if(EXISTS "${path}")
        file(READ "${path}" text)
        string(FIND "${text}" "\"\\p" at)
        if(NOT at EQUAL -1)
          message(FATAL_ERROR "velmar_add_classic_executable(${name}): ${source} writes "
            "\"\\p...\" Pascal-string literals, which only clang compiles (-fpascal-strings). "
            "Install clang, or configure with -DCMAKE_C_COMPILER=clang in a fresh build folder.")
        endif()
      endif()
    endforeach()
  endif()

  add_executable(${name} ${ARG_SOURCES} ${ARG_RESOURCES})
  set_target_properties(${name} PROPERTIES AUTOMOC OFF AUTORCC OFF AUTOUIC OFF)
  if(ARG_RESOURCES)
    # Listed so that a resource file made by the build is made first.
    set_source_files_properties(${ARG_RESOURCES} PROPERTIES HEADER_FILE_ONLY ON)
  endif()
  target_link_libraries(${name} PRIVATE Velmar::Classic)
  # Linked by the C++ compiler: the libraries are C++, and a sanitized build's runtime is
  # the C++ compiler's, whichever compiler made the C objects.
  get_property(languages GLOBAL PROPERTY ENABLED_LANGUAGES)
  if("CXX" IN_LIST languages)
    set_target_properties(${name} PROPERTIES LINKER_LANGUAGE CXX)
  endif()
  set(options -std=gnu99 -Wno-implicit-int -Wno-implicit-function-declaration
    -Wno-return-type -Wno-multichar -Wno-int-conversion -Wno-pointer-sign
    -Wno-incompatible-pointer-types -Wno-deprecated-declarations)
  if(clang)
    list(APPEND options -fpascal-strings -Wno-four-char-constants -Wno-non-literal-null-conversion
      -Wno-int-to-pointer-cast -Wno-pointer-to-int-cast)
  else()
    list(APPEND options -Wno-int-to-pointer-cast -Wno-pointer-to-int-cast)
  endif()
  if(NOT ARG_NO_PREFIX_HEADER)
    list(APPEND options -include ClassicToolbox.h)
  endif()
  target_compile_options(${name} PRIVATE $<$<COMPILE_LANGUAGE:C>:${options}>)

  if(ARG_RESOURCES)
    list(LENGTH ARG_RESOURCES count)
    if(count GREATER 1)
      message(FATAL_ERROR "velmar_add_classic_executable(${name}): one resource file only")
    endif()
    get_filename_component(resources "${ARG_RESOURCES}" ABSOLUTE)
    set(beside "$<TARGET_FILE_DIR:${name}>/${name}.rsrc")
    add_custom_command(TARGET ${name} POST_BUILD
      COMMAND ${CMAKE_COMMAND} -E copy_if_different "${resources}" "${beside}" VERBATIM)
  endif()
endfunction()
