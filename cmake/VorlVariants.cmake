# vorl_add_variants(<path to a module's sources, without suffix> ...)
#
# Adds the variants of modules to the library: sources whose suffix names the instructions that they
# are compiled for. Nothing else may be in them: what they shared with other sources might be the one
# copy that the linker keeps.
function(vorl_add_variants)
  if(NOT CMAKE_SYSTEM_PROCESSOR MATCHES "^(x86_64|AMD64)$" OR
     NOT CMAKE_CXX_COMPILER_ID MATCHES "GNU|Clang")
    return()
  endif()
  set(avx2_flags -mavx2 -mbmi2)
  set(avx512_flags ${avx2_flags} -mavx512f -mavx512bw -mavx512dq -mavx512vl -mavx512vbmi
    -mprefer-vector-width=512
    -Wno-uninitialized -Wno-maybe-uninitialized)  # GCC 12 finds those in its own header
  if(WIN32)
    # GCC takes the stack there for better aligned than it is where it keeps registers on it.
    list(APPEND avx2_flags -Wa,-muse-unaligned-vector-move)
    list(APPEND avx512_flags -Wa,-muse-unaligned-vector-move)
  endif()
  foreach(variant IN ITEMS avx2 avx512)
    foreach(module IN LISTS ARGN)
      set(source ${CMAKE_CURRENT_SOURCE_DIR}/${module}_${variant}.cpp)
      target_sources(vorl PRIVATE ${source})
      set_source_files_properties(${source} TARGET_DIRECTORY vorl PROPERTIES
        COMPILE_OPTIONS "${${variant}_flags}")
    endforeach()
  endforeach()
  target_compile_definitions(vorl PRIVATE VORL_X86_KERNELS)
endfunction()
