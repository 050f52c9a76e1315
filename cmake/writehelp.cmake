# cmake -DPROGRAM=qm-rps -DFOLDER=out -DPAGES="a.1;b.1" -DCHANGES=... -DDEBIAN_CHANGES=... -P writehelp.cmake
# Lets the program write its help in other forms: manual pages in both languages, packed as man reads
# them, and the completion of shells. PAGES are further manual pages, written by hand.
cmake_minimum_required(VERSION 3.25)

function(run)
  execute_process(COMMAND ${ARGN} COMMAND_ERROR_IS_FATAL ANY)
endfunction()

file(REMOVE_RECURSE ${FOLDER})
file(MAKE_DIRECTORY ${FOLDER}/man/man1 ${FOLDER}/man/it/man1)
run(${PROGRAM} help --man ${FOLDER}/man/man1)
run(${PROGRAM} --lang it help --man ${FOLDER}/man/it/man1)
foreach(page ${PAGES})
  file(COPY ${page} DESTINATION ${FOLDER}/man/man1)
endforeach()
run(${PROGRAM} help --completion bash OUTPUT_FILE ${FOLDER}/qm-rps.bash)
run(${PROGRAM} help --completion zsh OUTPUT_FILE ${FOLDER}/_qm-rps)

find_program(gzip gzip)
if(gzip) # -n: no name and no time, so that the same input gives the same bytes
  file(GLOB pages ${FOLDER}/man/man1/*.1 ${FOLDER}/man/it/man1/*.1)
  run(${gzip} -9n ${pages})
  run(${gzip} -9nc ${CHANGES} OUTPUT_FILE ${FOLDER}/changelog.gz)
  run(${gzip} -9nc ${DEBIAN_CHANGES} OUTPUT_FILE ${FOLDER}/changelog.Debian.gz)
else()
  message(STATUS "no gzip: manual pages stay unpacked, no changelog")
endif()
