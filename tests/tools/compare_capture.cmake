# Runs one sample program through a capture library and compares the shim's capture of the
# last swap with the sample's own PNG of that frame.
set(ENV{EGL_PLATFORM} surfaceless)
set(ENV{LD_LIBRARY_PATH} "${LIBRARY_DIR}")
set(ENV{OVO_SWAP_CAPTURE} "${OUTPUT}/capture.png")
file(REMOVE_RECURSE "${OUTPUT}")
file(MAKE_DIRECTORY "${OUTPUT}")
execute_process(COMMAND "${PROGRAM}" "${OUTPUT}/own.png" --frames 4
  RESULT_VARIABLE status OUTPUT_VARIABLE out ERROR_VARIABLE err)
if(NOT status EQUAL 0)
  message(FATAL_ERROR "${PROGRAM} failed (${status}):\n${out}${err}")
endif()
execute_process(COMMAND "${FRAMES_TOOL}" compare "${OUTPUT}/capture.png" "${OUTPUT}/own.png"
  RESULT_VARIABLE differ OUTPUT_VARIABLE out ERROR_VARIABLE err)
if(NOT differ EQUAL 0)
  message(FATAL_ERROR "the capture at the swap is not the sample's frame:\n${out}${err}")
endif()
