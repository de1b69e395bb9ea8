# Renders one sample through a capture copy of the library with a stereo profile installed,
# and on Mesa directly once per eye, where the sample applies the eye's transform itself.
# The frame at the vendor's swap must equal the two eye images interleaved by column (or,
# without interleaving, the single reference image).
#   PROFILE_TOOL PROFILE ROOT LIBRARY_DIR OVO_PROGRAM MESA_PROGRAM FRAMES_TOOL OUTPUT
#   PROCESS_NAME (optional)  RUN_ARGS  EYE_ARGS (;-lists)  EYE0_COLUMNS (even|odd, or empty)
#   INTERLEAVE_ARGS (optional ;-list): more options of `ovo-frames interleave`
#   LIVE_AT_EXIT (optional): the library's vendor GLES is the object-counting stand-in; its
#     report at the program's end must have seen objects made and count exactly these live,
#     e.g. "programs 0 shaders 0 textures 0 framebuffers 0 renderbuffers 0 buffers 0"
set(ENV{EGL_PLATFORM} surfaceless)
file(REMOVE_RECURSE "${OUTPUT}")
file(MAKE_DIRECTORY "${OUTPUT}" "${ROOT}/sdcard/stereoconv/game")

function(run)
  execute_process(COMMAND ${ARGN} RESULT_VARIABLE status OUTPUT_VARIABLE out ERROR_VARIABLE err)
  if(NOT status EQUAL 0)
    message(FATAL_ERROR "${ARGN}\nfailed (${status}):\n${out}${err}")
  endif()
endfunction()

run("${PROFILE_TOOL}" write "${PROFILE}" -o "${ROOT}/sdcard/stereoconv/game/stereo_gm.ovo")

# Through the library, under the process name the profile is meant for.
set(launcher "")
if(PROCESS_NAME)
  set(launcher bash -c "exec -a \"$0\" \"$@\"" "${PROCESS_NAME}")
endif()
set(ENV{LD_LIBRARY_PATH} "${LIBRARY_DIR}")
set(ENV{OVO_SWAP_CAPTURE} "${OUTPUT}/raw.png")
if(DEFINED LIVE_AT_EXIT)
  set(ENV{OVO_GL_COUNT} "${OUTPUT}/objects.count")
endif()
run(${launcher} "${OVO_PROGRAM}" "${OUTPUT}/own.png" ${RUN_ARGS})
unset(ENV{LD_LIBRARY_PATH})
unset(ENV{OVO_SWAP_CAPTURE})
unset(ENV{OVO_GL_COUNT})
if(EXISTS "${ROOT}/sdcard/stereoconv/game/stereo_gm.ovo")
  message(FATAL_ERROR "the library did not take the profile (the file is still there)")
endif()
# What is wrong, reported together at the end.
set(problems "")
if(DEFINED LIVE_AT_EXIT)
  set(report "")
  if(EXISTS "${OUTPUT}/objects.count")
    file(STRINGS "${OUTPUT}/objects.count" report REGEX "^exit ")
  endif()
  if(NOT report MATCHES "^exit made ([0-9]+) rss_kb -?[0-9]+ (.*)$" OR CMAKE_MATCH_1 EQUAL 0)
    string(APPEND problems "the counting stand-in saw no GL object made: '${report}'\n")
  elseif(NOT CMAKE_MATCH_2 STREQUAL LIVE_AT_EXIT)
    string(APPEND problems "GL objects live at the end: '${CMAKE_MATCH_2}', expected "
      "'${LIVE_AT_EXIT}' (${OUTPUT}/objects.count)\n")
  endif()
endif()

if(EYE0_COLUMNS)
  foreach(eye 0 1)
    run("${MESA_PROGRAM}" "${OUTPUT}/eye${eye}.png" ${RUN_ARGS} --eye ${eye} ${EYE_ARGS})
  endforeach()
  run("${FRAMES_TOOL}" interleave "${OUTPUT}/eye0.png" "${OUTPUT}/eye1.png"
    --eye0-columns ${EYE0_COLUMNS} ${INTERLEAVE_ARGS} -o "${OUTPUT}/expected.png")
else()
  run("${MESA_PROGRAM}" "${OUTPUT}/expected.png" ${RUN_ARGS} ${EYE_ARGS})
endif()

execute_process(COMMAND "${FRAMES_TOOL}" compare "${OUTPUT}/raw.png" "${OUTPUT}/expected.png"
  RESULT_VARIABLE differ OUTPUT_VARIABLE out ERROR_VARIABLE err)
if(NOT differ EQUAL 0)
  string(APPEND problems
    "the stereo frame differs from the expected one (${OUTPUT}):\n${out}${err}")
endif()
if(problems)
  message(FATAL_ERROR "${problems}")
endif()
message(STATUS "identical: ${OUTPUT}/raw.png ${OUTPUT}/expected.png")
