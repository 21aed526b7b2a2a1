# Checks the types of the page's sources, with the packages of FOLDER.
file(REMOVE_RECURSE "${FOLDER}/src")
file(COPY "${SOURCE}/src" "${SOURCE}/tsconfig.json" DESTINATION "${FOLDER}")
execute_process(COMMAND "${NODE}" "${FOLDER}/node_modules/typescript/bin/tsc" -p "${FOLDER}" RESULT_VARIABLE failed)
if(failed)
  message(FATAL_ERROR "the types of the page are wrong")
endif()
