# Renders one sample program twice, on Mesa and through the library, and compares the PNGs
# byte for byte (the writer is deterministic, so equal files mean equal pixels).
set(ENV{EGL_PLATFORM} surfaceless)
file(MAKE_DIRECTORY "${OUTPUT}")
foreach(variant MESA OVO)
  string(TOLOWER ${variant} name)
  execute_process(COMMAND "${${variant}_PROGRAM}" "${OUTPUT}/${name}.png"
    RESULT_VARIABLE status OUTPUT_VARIABLE out ERROR_VARIABLE err)
  if(NOT status EQUAL 0)
    message(FATAL_ERROR "${${variant}_PROGRAM} failed (${status}):\n${out}${err}")
  endif()
endforeach()
execute_process(COMMAND ${CMAKE_COMMAND} -E compare_files "${OUTPUT}/mesa.png" "${OUTPUT}/ovo.png"
  RESULT_VARIABLE differ)
if(NOT differ EQUAL 0)
  message(FATAL_ERROR "the image through the library differs from Mesa's: ${OUTPUT}")
endif()
message(STATUS "identical: ${OUTPUT}/mesa.png ${OUTPUT}/ovo.png")
