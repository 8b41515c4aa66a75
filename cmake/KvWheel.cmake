# Makes a wheel of a build tree, for the interpreter that it was built for: cmake -DTREE= -DTAG= -P KvWheel.cmake. The
# package lies as pip wants it, and what it loads where it finds it from there: in an environment as in an installed tree.
set(stage ${TREE}/wheel)
set(installed ${stage}/installed)
file(REMOVE_RECURSE ${stage})
execute_process(COMMAND ${CMAKE_COMMAND} --install ${TREE} --strip --prefix ${installed}
                OUTPUT_QUIET COMMAND_ERROR_IS_FATAL ANY)
file(GLOB info RELATIVE ${installed}/lib/python3/dist-packages ${installed}/lib/python3/dist-packages/*.dist-info)
string(REPLACE .dist-info .data data ${info})
file(RENAME ${installed}/lib/python3/dist-packages ${stage}/content)
foreach(part lib/velmora share/velmora)
  file(COPY ${installed}/${part}/ DESTINATION ${stage}/content/${data}/data/${part})
endforeach()
file(WRITE ${stage}/content/${info}/WHEEL "Wheel-Version: 1.0\nGenerator: velmora\nRoot-Is-Purelib: false\nTag: ${TAG}\n")
execute_process(COMMAND /usr/bin/python3 -m wheel pack --dest-dir ${TREE} ${stage}/content
                OUTPUT_QUIET COMMAND_ERROR_IS_FATAL ANY)
file(REMOVE_RECURSE ${stage})
