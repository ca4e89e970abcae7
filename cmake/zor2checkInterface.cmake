# zor2check_interface(): keeps a CMake target's published C++ interface compatible with a
# description of it committed in the source tree.
#
#   zor2check_interface(NAME <name> TARGET <target> PUBLIC_HEADERS <dir>
#                       [PROTECTED_HEADERS <dir>] REFERENCE <file.xml> [BASELINE <file.xml>]
#                       [LEVEL <M4Rnn>] [FRAMEWORK <framework>]
#                       [OPTIONS <zor2check option>...]
#                       [DESCRIBE_OPTIONS <zor2describe option>...])
#
# - Target <name>_interface (built by default): zor2describe describes the headers under
#   PUBLIC_HEADERS (and PROTECTED_HEADERS) with <target>'s own include directories, compile
#   definitions and C++ standard, into <build>/zor2check/<name>/description.xml. Headers
#   without a @ZOR2Level tag are described as L1.
# - Test <name>_interface: zor2check checks that description against the committed REFERENCE
#   with -fail, accepting the findings of BASELINE when given and, with LEVEL, checking the L1
#   files with -L -level LEVEL. It leaves report.xml and the exports findings.md,
#   findings.html and findings.sarif in <build>/zor2check/<name>/, and when the check fails it
#   prints the findings and how to accept the change. The SARIF file names the headers by
#   their path from the top source directory (-sarif-base PUBLIC_HEADERS).
# - Target <name>_update_interface: rewrites REFERENCE from the headers, for a change that is
#   meant (commit the file, so that the change shows in review).
#
# Relative paths are taken from the current source directory. FRAMEWORK names the framework in
# the description (default: <name>). OPTIONS go to zor2check, DESCRIBE_OPTIONS to zor2describe
# (-default-usage U1, for example). Paths and values cannot hold a double quote, which the
# programs' argument files do not carry: a compile definition's quotes are dropped.

include_guard(GLOBAL)
if(CMAKE_VERSION VERSION_LESS 3.15)
  message(FATAL_ERROR "zor2check_interface() needs CMake 3.15 or later")
endif()
set_property(GLOBAL PROPERTY ZOR2CHECK_CMAKE_DIR "${CMAKE_CURRENT_LIST_DIR}")

# Sets `out` to `value` quoted for an argument file of the programs, or stops with an error
# that names `what` when the value holds a double quote, which such a file cannot carry.
function(_zor2check_quoted out value what)
  if(value MATCHES "\"")
    message(FATAL_ERROR "zor2check_interface: ${what} holds a double quote: ${value}")
  endif()
  set(${out} "\"${value}\"" PARENT_SCOPE)
endfunction()

# Sets `out` to a generator expression giving the C++ standard clang should use for
# `target`: the highest of its CXX_STANDARD and of the cxx_std_NN features it and its
# dependencies require, as CMake itself chooses; empty when none is set.
function(_zor2check_standard out target property_prefix)
  set(features "$<TARGET_PROPERTY:${target},${property_prefix}COMPILE_FEATURES>")
  set(standard "")
  # libclang 14 knows C++23 as c++2b and nothing later.
  foreach(level_and_flag 98:c++98 11:c++11 14:c++14 17:c++17 20:c++20 23:c++2b 26:c++2b)
    string(REPLACE ":" ";" level_and_flag "${level_and_flag}")
    list(GET level_and_flag 0 level)
    list(GET level_and_flag 1 flag)
    set(wanted "$<IN_LIST:cxx_std_${level},${features}>")
    if(property_prefix STREQUAL "")
      set(wanted "$<OR:$<STREQUAL:$<TARGET_PROPERTY:${target},CXX_STANDARD>,${level}>,${wanted}>")
    endif()
    set(standard "$<IF:${wanted},${flag},${standard}>")
  endforeach()
  set(${out} "${standard}" PARENT_SCOPE)
endfunction()

function(zor2check_interface)
  cmake_parse_arguments(PARSE_ARGV 0 arg ""
    "NAME;TARGET;PUBLIC_HEADERS;PROTECTED_HEADERS;REFERENCE;BASELINE;LEVEL;FRAMEWORK"
    "OPTIONS;DESCRIBE_OPTIONS")
  if(arg_UNPARSED_ARGUMENTS)
    message(FATAL_ERROR "zor2check_interface: unknown arguments: ${arg_UNPARSED_ARGUMENTS}")
  endif()
  foreach(required NAME TARGET PUBLIC_HEADERS REFERENCE)
    if(NOT arg_${required})
      message(FATAL_ERROR "zor2check_interface: ${required} is missing")
    endif()
  endforeach()
  set(name "${arg_NAME}")
  if(NOT name MATCHES "^[A-Za-z0-9_.+-]+$")
    message(FATAL_ERROR "zor2check_interface: NAME ${name} must be a word of letters, digits "
      "and _.+- (it names targets and a test)")
  endif()
  if(NOT TARGET "${arg_TARGET}")
    message(FATAL_ERROR "zor2check_interface(${name}): ${arg_TARGET} is not a target (call the "
      "function after the target is defined)")
  endif()
  if(NOT TARGET zor2check::zor2describe)
    message(FATAL_ERROR "zor2check_interface(${name}): zor2describe is not installed (Debian "
      "package zor2describe)")
  endif()

  get_target_property(target "${arg_TARGET}" ALIASED_TARGET)
  if(NOT target)
    set(target "${arg_TARGET}")
  endif()
  # An interface library has only the usage requirements it hands on.
  get_target_property(type "${target}" TYPE)
  set(property_prefix "")
  if(type STREQUAL "INTERFACE_LIBRARY")
    set(property_prefix "INTERFACE_")
  endif()

  foreach(path PUBLIC_HEADERS PROTECTED_HEADERS REFERENCE BASELINE)
    if(arg_${path})
      get_filename_component(arg_${path} "${arg_${path}}" ABSOLUTE
        BASE_DIR "${CMAKE_CURRENT_SOURCE_DIR}")
    endif()
  endforeach()
  set(header_dirs "${arg_PUBLIC_HEADERS}")
  if(arg_PROTECTED_HEADERS)
    list(APPEND header_dirs "${arg_PROTECTED_HEADERS}")
  endif()
  foreach(dir IN LISTS header_dirs)
    if(NOT IS_DIRECTORY "${dir}")
      message(FATAL_ERROR "zor2check_interface(${name}): ${dir} is not a directory")
    endif()
  endforeach()
  set(framework "${name}")
  if(arg_FRAMEWORK)
    set(framework "${arg_FRAMEWORK}")
  endif()

  set(dir "${CMAKE_CURRENT_BINARY_DIR}/zor2check/${name}")
  set(description "${dir}/description.xml")
  set(findings "${dir}/findings")
  get_property(cmake_dir GLOBAL PROPERTY ZOR2CHECK_CMAKE_DIR)

  # The description. The target's properties are known only at generation time, so they reach
  # zor2describe through an argument file written then, one per configuration, in which each
  # value is quoted so that blanks survive.
  set(content "")
  set(describe "-framework;${framework};-public;${arg_PUBLIC_HEADERS}")
  if(arg_PROTECTED_HEADERS)
    list(APPEND describe -protected "${arg_PROTECTED_HEADERS}")
  endif()
  list(APPEND describe -o "${description}.new")
  foreach(item IN LISTS describe)
    _zor2check_quoted(item "${item}" "an argument of the description")
    string(APPEND content "${item}\n")
  endforeach()
  # Untagged headers are then checked by -L as well.
  string(APPEND content "-default-level L1\n")
  set(includes "$<TARGET_PROPERTY:${target},${property_prefix}INCLUDE_DIRECTORIES>")
  set(includes "$<FILTER:$<REMOVE_DUPLICATES:${includes}>,EXCLUDE,^$>")
  set(definitions "$<TARGET_PROPERTY:${target},${property_prefix}COMPILE_DEFINITIONS>")
  set(definitions "$<FILTER:$<REMOVE_DUPLICATES:${definitions}>,EXCLUDE,^$>")
  _zor2check_standard(standard "${target}" "${property_prefix}")
  string(APPEND content
    "$<$<NOT:$<STREQUAL:${includes},>>:-I \"$<JOIN:${includes},\"\n-I \">\"\n>"
    "$<$<NOT:$<STREQUAL:${definitions},>>:-D \"$<JOIN:${definitions},\"\n-D \">\"\n>"
    "$<$<NOT:$<STREQUAL:${standard},>>:-std ${standard}\n>")
  foreach(option IN LISTS arg_DESCRIBE_OPTIONS)
    _zor2check_quoted(option "${option}" "DESCRIBE_OPTIONS")
    string(APPEND content "${option}\n")
  endforeach()
  set(describe_arguments "${dir}/describe$<$<BOOL:$<CONFIG>>:-$<CONFIG>>.args")
  file(GENERATE OUTPUT "${describe_arguments}" CONTENT "${content}")

  set(headers_globs "")
  foreach(header_dir IN LISTS header_dirs)
    foreach(extension h hh hpp hxx h++)
      list(APPEND headers_globs "${header_dir}/*.${extension}")
    endforeach()
  endforeach()
  # Listed again at each build, so that a new header is described.
  file(GLOB_RECURSE headers CONFIGURE_DEPENDS ${headers_globs})
  set(update "cmake --build \"${CMAKE_BINARY_DIR}\" --target ${name}_update_interface")
  set(note_arguments "-DNAME=${name}" "-DREFERENCE=${arg_REFERENCE}"
    "-DDESCRIPTION=${description}" "-DUPDATE=${update}")
  # Written beside and renamed, so that a failed description does not pass for a fresh one;
  # then a note when the headers no longer give the reference.
  add_custom_command(OUTPUT "${description}"
    COMMAND zor2check::zor2describe = "${describe_arguments}"
    COMMAND "${CMAKE_COMMAND}" -E rename "${description}.new" "${description}"
    COMMAND "${CMAKE_COMMAND}" ${note_arguments} -DNOTE_ONLY=ON
      -P "${cmake_dir}/zor2checkInterfaceCheck.cmake"
    DEPENDS ${headers} "${describe_arguments}" "$<TARGET_FILE:zor2check::zor2describe>"
    COMMENT "zor2check: describing the interface ${name}"
    VERBATIM)
  add_custom_target(${name}_interface ALL DEPENDS "${description}")
  # Headers the target generates exist once it is built (an interface library builds nothing).
  if(NOT type STREQUAL "INTERFACE_LIBRARY")
    add_dependencies(${name}_interface "${target}")
  endif()

  # The check, through an argument file as well.
  set(check "-r;${arg_REFERENCE};-c;${description};-o;${dir}/report.xml;-fail")
  if(arg_BASELINE)
    list(APPEND check -baseline "${arg_BASELINE}")
  endif()
  if(arg_LEVEL)
    list(APPEND check -L -level "${arg_LEVEL}")
  endif()
  foreach(extension md html sarif)
    list(APPEND check -export "${findings}.${extension}")
  endforeach()
  # The public headers' folder in the source tree, so that code-scanning annotations land on
  # the right file; a later -sarif-base in OPTIONS wins.
  file(RELATIVE_PATH sarif_base "${CMAKE_SOURCE_DIR}" "${arg_PUBLIC_HEADERS}")
  if(NOT sarif_base MATCHES "^\\.\\.(/|$)" AND NOT IS_ABSOLUTE "${sarif_base}")
    list(APPEND check -sarif-base "${sarif_base}")
  endif()
  list(APPEND check ${arg_OPTIONS})
  set(content "")
  foreach(item IN LISTS check)
    _zor2check_quoted(item "${item}" "an argument of the check")
    string(APPEND content "${item}\n")
  endforeach()
  file(GENERATE OUTPUT "${dir}/check.args" CONTENT "${content}")

  add_test(NAME ${name}_interface
    COMMAND "${CMAKE_COMMAND}" "-DZOR2CHECK=$<TARGET_FILE:zor2check::zor2check>"
      "-DARGUMENTS=${dir}/check.args" "-DFINDINGS=${findings}" ${note_arguments}
      -P "${cmake_dir}/zor2checkInterfaceCheck.cmake")
  set_tests_properties(${name}_interface PROPERTIES LABELS zor2check)

  get_filename_component(reference_dir "${arg_REFERENCE}" DIRECTORY)
  add_custom_target(${name}_update_interface
    COMMAND "${CMAKE_COMMAND}" -E make_directory "${reference_dir}"
    COMMAND "${CMAKE_COMMAND}" -E copy "${description}" "${arg_REFERENCE}.zor2check-new"
    COMMAND "${CMAKE_COMMAND}" -E rename "${arg_REFERENCE}.zor2check-new" "${arg_REFERENCE}"
    COMMENT "zor2check: writing ${arg_REFERENCE} from the headers"
    VERBATIM)
  add_dependencies(${name}_update_interface ${name}_interface)
endfunction()
