# Builds the library's objects once and links them into as many libraries as there are
# device roots: the shipped one, and the tests' own.

set(OVO_WARNINGS -Wall -Wextra -Wshadow -Wnon-virtual-dtor)
set(OVO_ENTRY_MAP "${PROJECT_SOURCE_DIR}/src/entry/exports.map")

add_library(ovo_core OBJECT)
target_include_directories(ovo_core PUBLIC "${PROJECT_SOURCE_DIR}/src")
target_compile_options(ovo_core PRIVATE ${OVO_WARNINGS}
  -fno-exceptions -fno-rtti -fvisibility=hidden -fvisibility-inlines-hidden -fno-plt)
target_link_libraries(ovo_core PUBLIC ${CMAKE_DL_LIBS} Threads::Threads)
find_package(Threads REQUIRED)

# ovo_add_gles_library(NAME SHARED|STATIC ROOT): the library's objects with device root ROOT.
# A shared one exports exactly the GL and EGL entry points.
function(ovo_add_gles_library name kind root)
  add_library(${name}_root OBJECT "${PROJECT_SOURCE_DIR}/src/platform/device_root.cpp")
  target_include_directories(${name}_root PRIVATE "${PROJECT_SOURCE_DIR}/src")
  target_compile_definitions(${name}_root PRIVATE "OVO_DEVICE_ROOT=\"${root}\"")
  add_library(${name} ${kind} $<TARGET_OBJECTS:ovo_core> $<TARGET_OBJECTS:${name}_root>)
  target_include_directories(${name} PUBLIC "${PROJECT_SOURCE_DIR}/src")
  target_link_libraries(${name} PUBLIC ${CMAKE_DL_LIBS} Threads::Threads)
  if(kind STREQUAL "SHARED")
    target_link_options(${name} PRIVATE "-Wl,--version-script=${OVO_ENTRY_MAP}"
      "-Wl,--no-undefined")
    set_target_properties(${name} PROPERTIES LINK_DEPENDS "${OVO_ENTRY_MAP}")
  endif()
endfunction()

# ovo_link_vendor(TARGET ROOT EGL GLES1 GLES2): after TARGET is built, ROOT's vendor folder
# holds the three given libraries under the first GPU tag.
function(ovo_link_vendor target root egl gles1 gles2)
  set(dir "${root}/system/vendor/lib/egl")
  add_custom_command(TARGET ${target} POST_BUILD
    COMMAND ${CMAKE_COMMAND} -E make_directory "${dir}"
    COMMAND ${CMAKE_COMMAND} -E create_symlink "${egl}" "${dir}/libEGL_mali.so"
    COMMAND ${CMAKE_COMMAND} -E create_symlink "${gles1}" "${dir}/libGLESv1_CM_mali.so"
    COMMAND ${CMAKE_COMMAND} -E create_symlink "${gles2}" "${dir}/libGLESv2_mali.so"
    VERBATIM)
endfunction()

# ovo_link_mesa_vendor(TARGET ROOT): the host's Mesa as the vendor of ROOT.
function(ovo_link_mesa_vendor target root)
  find_library(OVO_MESA_EGL NAMES libEGL.so.1 EGL REQUIRED)
  find_library(OVO_MESA_GLES1 NAMES libGLESv1_CM.so.1 GLESv1_CM REQUIRED)
  find_library(OVO_MESA_GLES2 NAMES libGLESv2.so.2 GLESv2 REQUIRED)
  ovo_link_vendor(${target} "${root}" "${OVO_MESA_EGL}" "${OVO_MESA_GLES1}" "${OVO_MESA_GLES2}")
endfunction()
