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
# holds the three given libraries under the first GPU tag. A library of this build (a
# generator expression) is linked; one of the host's is copied under the vendor file name
# and given that name as its soname, as a device's vendor libraries carry names of their
# own: a program that opens libGLESv2.so.2 by name after the GLES library has opened the
# vendor's must find the GLES library, not the vendor's copy under its standard soname.
function(ovo_link_vendor target root egl gles1 gles2)
  set(dir "${root}/system/vendor/lib/egl")
  set(commands COMMAND ${CMAKE_COMMAND} -E make_directory "${dir}")
  foreach(kind IN ITEMS EGL GLESv1_CM GLESv2)
    if(kind STREQUAL "EGL")
      set(library "${egl}")
    elseif(kind STREQUAL "GLESv1_CM")
      set(library "${gles1}")
    else()
      set(library "${gles2}")
    endif()
    set(name "lib${kind}_mali.so")
    if(library MATCHES "^\\$<")
      list(APPEND commands COMMAND ${CMAKE_COMMAND} -E create_symlink "${library}" "${dir}/${name}")
    else()
      list(APPEND commands COMMAND ${CMAKE_COMMAND} -E remove -f "${dir}/${name}"
        COMMAND ${CMAKE_COMMAND} -E copy "${library}" "${dir}/${name}"
        COMMAND "${OVO_PATCHELF}" --set-soname "${name}" "${dir}/${name}")
    endif()
  endforeach()
  add_custom_command(TARGET ${target} POST_BUILD ${commands} VERBATIM)
endfunction()

find_program(OVO_PATCHELF patchelf REQUIRED)

# ovo_link_mesa_vendor(TARGET ROOT): the host's Mesa as the vendor of ROOT.
function(ovo_link_mesa_vendor target root)
  find_library(OVO_MESA_EGL NAMES libEGL.so.1 EGL REQUIRED)
  find_library(OVO_MESA_GLES1 NAMES libGLESv1_CM.so.1 GLESv1_CM REQUIRED)
  find_library(OVO_MESA_GLES2 NAMES libGLESv2.so.2 GLESv2 REQUIRED)
  ovo_link_vendor(${target} "${root}" "${OVO_MESA_EGL}" "${OVO_MESA_GLES1}" "${OVO_MESA_GLES2}")
endfunction()
