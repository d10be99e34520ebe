# What makes a mistake in the programs hard to use: addresses that nobody can guess, tables that nobody can overwrite,
# and checks that stop a program before it continues with corrupt memory.
#
# Not here: the marks of Intel's control-flow enforcement (-fcf-protection). Debian 12's C library and start-up code do
# not have them, so the linker leaves them out of any program; they would only cost 1 % of the instructions.
#
# Sanitized builds have checks of their own, which these would get in the way of.
if(NOT VESPSCOPE_SANITIZE)
  # What a module is made of is compiled for one (-fPIC) already.
  target_compile_options(vespscope_options INTERFACE
                         $<$<NOT:$<BOOL:$<TARGET_PROPERTY:POSITION_INDEPENDENT_CODE>>>:-fPIE> -fstack-clash-protection)
  target_link_options(vespscope_options INTERFACE $<$<STREQUAL:$<TARGET_PROPERTY:TYPE>,EXECUTABLE>:-pie>
                      LINKER:-z,relro LINKER:-z,now LINKER:-z,noexecstack LINKER:-z,separate-code)
  # Sizes of copies are checked where the compiler knows them, which it does when it optimises.
  target_compile_definitions(vespscope_options INTERFACE $<$<NOT:$<CONFIG:Debug>>:_FORTIFY_SOURCE=2>)
endif()

# vespscope_guard(TARGET): checks the stack of functions with arrays, and the library's indexes and empty containers.
function(vespscope_guard target)
  if(VESPSCOPE_SANITIZE OR VESPSCOPE_PRECOMPILED)  # what is precompiled is made once, for guarded layers and others
    return()
  endif()
  target_compile_options(${target} PRIVATE -fstack-protector-strong)
  target_compile_definitions(${target} PRIVATE _GLIBCXX_ASSERTIONS)
endfunction()
