# Makes mistakes in the programs hard to exploit: addresses that cannot be guessed, tables that cannot be overwritten,
# and checks that stop a program before it continues with corrupt memory.
#
# Not used: Intel's control-flow enforcement (-fcf-protection). Debian 12's C library and start-up code lack its marks,
# so the linker removes them from any program; they would only cost 1 % of the instructions.
#
# Sanitized builds have checks of their own, with which these would interfere.
if(NOT VESPSCOPE_SANITIZE)
  # The parts of a module are compiled with -fPIC already.
  target_compile_options(vespscope_options INTERFACE
                         $<$<NOT:$<BOOL:$<TARGET_PROPERTY:POSITION_INDEPENDENT_CODE>>>:-fPIE> -fstack-clash-protection)
  target_link_options(vespscope_options INTERFACE $<$<STREQUAL:$<TARGET_PROPERTY:TYPE>,EXECUTABLE>:-pie>
                      LINKER:-z,relro LINKER:-z,now LINKER:-z,noexecstack LINKER:-z,separate-code)
  # Checks the sizes of copies where the compiler knows them, which requires optimisation.
  target_compile_definitions(vespscope_options INTERFACE $<$<NOT:$<CONFIG:Debug>>:_FORTIFY_SOURCE=2>)
endif()

# vespscope_guard(TARGET): adds checks of the stack in functions with arrays, and of the library's indexes and empty
# containers.
function(vespscope_guard target)
  if(VESPSCOPE_SANITIZE OR VESPSCOPE_PRECOMPILED)  # what is precompiled is made once, for guarded layers and others
    return()
  endif()
  target_compile_options(${target} PRIVATE -fstack-protector-strong)
  target_compile_definitions(${target} PRIVATE _GLIBCXX_ASSERTIONS)
endfunction()
