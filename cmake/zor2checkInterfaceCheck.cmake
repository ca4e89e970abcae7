# The test that zor2check_interface() adds, run as cmake -P with:
#   ZOR2CHECK    the zor2check program
#   ARGUMENTS    its argument file (the check of DESCRIPTION against REFERENCE, with -fail)
#   NAME         the interface's name
#   REFERENCE    the committed description
#   DESCRIPTION  the description of the headers as they are
#   FINDINGS     the exports' path without its extension (.md, .html, .sarif)
#   UPDATE       the command that rewrites REFERENCE from the headers
# Fails when the headers are not compatible with REFERENCE, printing the findings and how to
# accept a change that is meant; says so, and passes, when they changed compatibly.
# With NOTE_ONLY (at build time, once the headers are described, where ZOR2CHECK, ARGUMENTS
# and FINDINGS are not needed) it only says whether the headers still give REFERENCE.

# Says when the headers no longer give the reference byte for byte.
function(note_change)
  if(NOT EXISTS "${REFERENCE}")
    message("${NAME}: there is no interface reference ${REFERENCE} yet. Write it from the "
      "headers with\n  ${UPDATE}\nand commit it.")
    return()
  endif()
  file(SHA256 "${REFERENCE}" reference_digest)
  file(SHA256 "${DESCRIPTION}" description_digest)
  if(NOT reference_digest STREQUAL description_digest)
    message("${NAME}: the interface changed: the headers no longer give ${REFERENCE}. Once the "
      "change is checked, record it with\n  ${UPDATE}\nand commit it, so that it shows in "
      "review.")
  endif()
endfunction()

set(required NAME REFERENCE DESCRIPTION UPDATE)
if(NOT NOTE_ONLY)
  list(APPEND required ZOR2CHECK ARGUMENTS FINDINGS)
endif()
foreach(variable IN LISTS required)
  if(NOT DEFINED ${variable})
    message(FATAL_ERROR "zor2checkInterfaceCheck.cmake: ${variable} is not set")
  endif()
endforeach()
if(NOTE_ONLY)
  note_change()
  return()
endif()

if(NOT EXISTS "${DESCRIPTION}")
  message(FATAL_ERROR "${NAME}: the headers have not been described yet: build the project "
    "(target ${NAME}_interface) before running the tests.")
endif()
if(NOT EXISTS "${REFERENCE}")
  message(FATAL_ERROR "${NAME}: there is no interface reference ${REFERENCE} yet. Write it "
    "from the headers with\n  ${UPDATE}\nand commit it.")
endif()

execute_process(COMMAND "${ZOR2CHECK}" = "${ARGUMENTS}" RESULT_VARIABLE status)

if(status STREQUAL "0")
  note_change()
  return()
endif()

if(status STREQUAL "3")
  # The Markdown export's headline, the codes found with their full names, and the findings by
  # file; its run table is left out.
  file(READ "${FINDINGS}.md" findings)
  string(FIND "${findings}" "\n" headline_end)
  string(FIND "${findings}" "\n### " first_file)
  if(headline_end GREATER 0 AND first_file GREATER 0)
    string(SUBSTRING "${findings}" 0 ${headline_end} headline)
    string(SUBSTRING "${findings}" ${first_file} -1 by_file)
    string(REGEX MATCHALL "\n\\| `[A-Z]+` \\| [^\n]* \\| [1-9][0-9]* \\|" codes "${findings}")
    string(REPLACE ";" "" codes "${codes}")
    string(CONCAT findings "${headline}\n\n| Code | Full name | Findings |\n| --- | --- | ---: |"
      "${codes}\n${by_file}")
  endif()
  message("${findings}")
  message(FATAL_ERROR "${NAME}: the headers are not compatible with the interface reference "
    "${REFERENCE}: see the findings above, or ${FINDINGS}.html. If the change is meant, "
    "rewrite the reference with\n  ${UPDATE}\nand commit it (or accept the findings in a "
    "baseline).")
endif()

message(FATAL_ERROR "${NAME}: zor2check could not complete the check (exit status ${status}: "
  "see its messages above).")
