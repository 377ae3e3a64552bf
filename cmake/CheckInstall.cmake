# Installs the build into a scratch prefix and checks that it holds what a desktop needs:
#   cmake -DBUILD=... -DPREFIX=... -DVERSION=... -DEDITOR=ON|OFF -P CheckInstall.cmake
cmake_minimum_required(VERSION 3.22)

function(fail)
  message(FATAL_ERROR ${ARGN})
endfunction()

file(REMOVE_RECURSE "${PREFIX}")
execute_process(COMMAND "${CMAKE_COMMAND}" --install "${BUILD}" --prefix "${PREFIX}"
  OUTPUT_QUIET RESULT_VARIABLE rc)
if(NOT rc EQUAL 0)
  fail("cmake --install failed (${rc})")
endif()

set(expected bin/mudsetup share/man/man1/mudsetup.1.gz share/doc/mudsetup/README.md
  share/doc/mudsetup/file-format.md share/doc/mudsetup/examples/estuary.setup
  share/doc/mudsetup/examples/estuary.2dm)
set(programs mudsetup)
if(EDITOR)
  list(APPEND programs mudsetup-editor)
  list(APPEND expected bin/mudsetup-editor share/man/man1/mudsetup-editor.1.gz
    share/applications/mudsetup-editor.desktop share/mime/packages/mudsetup.xml
    share/icons/hicolor/scalable/apps/mudsetup-editor.svg)
  foreach(size 16 24 32 48 64 128 256)
    list(APPEND expected share/icons/hicolor/${size}x${size}/apps/mudsetup-editor.png)
  endforeach()
endif()
foreach(f ${expected})
  if(NOT EXISTS "${PREFIX}/${f}")
    fail("not installed: ${f}")
  endif()
endforeach()

# The installed programs run from there and name the build's version; the example they
# bring along is valid.
foreach(program ${programs})
  execute_process(COMMAND "${PREFIX}/bin/${program}" --version
    OUTPUT_VARIABLE out RESULT_VARIABLE rc)
  if(NOT rc EQUAL 0 OR NOT out STREQUAL "${program} ${VERSION}\n")
    fail("${program} --version: exit ${rc}, '${out}'")
  endif()
endforeach()
execute_process(COMMAND "${PREFIX}/bin/mudsetup" validate
  "${PREFIX}/share/doc/mudsetup/examples/estuary.setup"
  OUTPUT_VARIABLE out ERROR_VARIABLE err RESULT_VARIABLE rc)
if(NOT rc EQUAL 0)
  fail("the installed example is not valid (${rc}): ${out}${err}")
endif()

# The pages read without warnings and carry the help, the exit codes and an example.
find_program(GROFF groff)
foreach(program ${programs})
  set(page "${BUILD}/share/man/${program}.1")
  file(READ "${page}" text)
  foreach(part ".SH SYNOPSIS" ".SH \"EXIT STATUS\"" ".SH EXAMPLE" "\\-\\-version")
    string(FIND "${text}" "${part}" at)
    if(at EQUAL -1)
      fail("${program}(1) lacks ${part}")
    endif()
  endforeach()
  if(GROFF)
    execute_process(COMMAND "${GROFF}" -t -man -Tutf8 -ww -z "${page}"
      ERROR_VARIABLE warnings RESULT_VARIABLE rc)
    if(NOT rc EQUAL 0 OR NOT warnings STREQUAL "")
      fail("${program}(1): ${warnings}")
    endif()
  endif()
endforeach()
file(READ "${BUILD}/share/man/mudsetup.1" text)
foreach(command validate format "datafile new" "mesh info")
  string(FIND "${text}" ".SS \"${command}\"" quoted)
  string(FIND "${text}" ".SS ${command}\n" plain)
  if(quoted EQUAL -1 AND plain EQUAL -1)
    fail("mudsetup(1) has no section for '${command}'")
  endif()
endforeach()

# The desktop entry starts an installed program with an installed icon, for the type the
# MIME package declares.
if(EDITOR)
  file(READ "${PREFIX}/share/applications/mudsetup-editor.desktop" entry)
  file(READ "${PREFIX}/share/mime/packages/mudsetup.xml" mime)
  string(REGEX MATCH "\nExec=([^ \n]+)" _ "${entry}")
  if(NOT EXISTS "${PREFIX}/bin/${CMAKE_MATCH_1}")
    fail("Exec names '${CMAKE_MATCH_1}', which is not installed")
  endif()
  string(REGEX MATCH "\nIcon=([^\n]+)" _ "${entry}")
  if(NOT EXISTS "${PREFIX}/share/icons/hicolor/scalable/apps/${CMAKE_MATCH_1}.svg")
    fail("Icon names '${CMAKE_MATCH_1}', which is not installed")
  endif()
  string(REGEX MATCH "\nMimeType=([^;\n]+)" _ "${entry}")
  string(FIND "${mime}" "<mime-type type=\"${CMAKE_MATCH_1}\">" at)
  if(at EQUAL -1)
    fail("MimeType '${CMAKE_MATCH_1}' is not the type of the MIME package")
  endif()
  foreach(part "<glob pattern=\"*.setup\"/>" "<comment>Mud-transport setup</comment>")
    string(FIND "${mime}" "${part}" at)
    if(at EQUAL -1)
      fail("the MIME package lacks ${part}")
    endif()
  endforeach()
endif()
file(REMOVE_RECURSE "${PREFIX}")
