# cmake -DDOXYGEN=... -DFILE=Doxyfile -DFOLDER=out -P reference.cmake
# Makes the reference and says how many public members have no comment of their own.
cmake_minimum_required(VERSION 3.25)
file(REMOVE_RECURSE ${FOLDER})
file(MAKE_DIRECTORY ${FOLDER})
execute_process(COMMAND ${DOXYGEN} ${FILE} COMMAND_ERROR_IS_FATAL ANY OUTPUT_QUIET)
file(STRINGS ${FOLDER}/warnings.log warnings)
set(others ${warnings})
list(FILTER warnings INCLUDE REGEX "is not documented|are not documented")
list(FILTER others INCLUDE REGEX "warning:")
list(FILTER others EXCLUDE REGEX "is not documented|are not documented")
set(places ${warnings}) # a member that many classes inherit is one
list(TRANSFORM places REPLACE ": warning.*" "")
list(REMOVE_DUPLICATES places)
list(LENGTH places count)
list(LENGTH others faults)
list(JOIN warnings "\n" text)
file(WRITE ${FOLDER}/undocumented.txt "${text}\n")
message(STATUS "${FOLDER}/html/index.html: ${count} public members without a comment of their own "
               "(undocumented.txt), ${faults} faulty comments (warnings.log)")
