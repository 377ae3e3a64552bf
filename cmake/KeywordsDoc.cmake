# Writes docs/keywords.md from the declarations: cmake -DMUDSETUP=... -DOUT=... -P KeywordsDoc.cmake
execute_process(COMMAND ${MUDSETUP} keywords --markdown OUTPUT_VARIABLE text RESULT_VARIABLE rc)
if(NOT rc EQUAL 0)
  message(FATAL_ERROR "mudsetup keywords --markdown failed (${rc})")
endif()
file(WRITE ${OUT} "${text}")
