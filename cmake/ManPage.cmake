# Writes a program's manual page from its own --help, so that the two never drift apart:
#   cmake -DEXE=... -DNAME=... -DSUMMARY=... -DVERSION=... -DEXTRA=file.roff -DOUT=file.1
#         [-DCOMMANDS=ON] -P ManPage.cmake
# With COMMANDS, each command listed under "commands:" gets a subsection of its own --help
# (and of each subcommand that its usage lines name). OUT.gz is written beside OUT.
cmake_minimum_required(VERSION 3.22)

function(run_help out)
  execute_process(COMMAND "${EXE}" ${ARGN} --help
    OUTPUT_VARIABLE text ERROR_VARIABLE err RESULT_VARIABLE rc)
  if(NOT rc EQUAL 0 OR text STREQUAL "")
    message(FATAL_ERROR "${EXE} ${ARGN} --help failed (${rc}): ${err}")
  endif()
  set(${out} "${text}" PARENT_SCOPE)
endfunction()

# Help text as roff that keeps its own line breaks and columns.
function(verbatim out text)
  string(REPLACE "\\" "\\e" text "${text}")
  string(REPLACE "-" "\\-" text "${text}")
  string(REGEX REPLACE "(^|\n)([.'])" "\\1\\\\&\\2" text "${text}")
  string(REGEX REPLACE "\n+$" "" text "${text}")
  set(${out} ".nf\n${text}\n.fi\n" PARENT_SCOPE)
endfunction()

run_help(help)
# The usage lines make the synopsis; the rest describes the program.
string(REGEX MATCH "^usage:[^\n]*(\n[ \t]+[^\n]+)*" usage "${help}")
string(LENGTH "${usage}" usage_length)
string(SUBSTRING "${help}" ${usage_length} -1 description)
string(REGEX REPLACE "(^|\n)usage: " "\\1" usage "${usage}")
string(REGEX REPLACE "(^|\n)[ \t]+(${NAME} )" "\\1\\2" usage "${usage}")
string(REGEX REPLACE "^\n+" "" description "${description}")

string(TOUPPER "${NAME}" upper)
string(REPLACE "-" "\\-" name_roff "${NAME}")
verbatim(synopsis "${usage}")
set(page ".TH ${upper} 1 \"\" \"${NAME} ${VERSION}\" \"User Commands\"\n")
string(APPEND page ".SH NAME\n${name_roff} \\- ${SUMMARY}\n.SH SYNOPSIS\n${synopsis}")
if(NOT description STREQUAL "")
  verbatim(text "${description}")
  string(APPEND page ".SH DESCRIPTION\n${text}")
endif()

if(COMMANDS)
  string(REGEX MATCH "\ncommands:\n(  [^\n]*\n)+" block "${help}")
  string(REGEX MATCHALL "\n  [a-z][a-z-]*" names "${block}")
  if(NOT names)
    message(FATAL_ERROR "${EXE} --help lists no commands")
  endif()
  string(APPEND page ".SH COMMANDS\n")
  foreach(name ${names})
    string(STRIP "${name}" name)
    run_help(text ${name})
    # A command made of subcommands names them in its usage lines.
    string(REGEX MATCHALL "${NAME} ${name} [a-z][a-z-]*" subs "${text}")
    list(REMOVE_DUPLICATES subs)
    if(subs)
      foreach(sub ${subs})
        string(REPLACE "${NAME} ${name} " "" sub "${sub}")
        run_help(subtext ${name} ${sub})
        verbatim(subtext "${subtext}")
        string(APPEND page ".SS \"${name} ${sub}\"\n${subtext}")
      endforeach()
    else()
      verbatim(text "${text}")
      string(APPEND page ".SS ${name}\n${text}")
    endif()
  endforeach()
endif()

file(READ "${EXTRA}" extra)
string(APPEND page "${extra}")
file(WRITE "${OUT}" "${page}")
execute_process(COMMAND gzip -n -9 -c "${OUT}" OUTPUT_FILE "${OUT}.gz" RESULT_VARIABLE rc)
if(NOT rc EQUAL 0)
  message(FATAL_ERROR "gzip of ${OUT} failed")
endif()
