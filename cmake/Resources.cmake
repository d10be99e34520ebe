# The main resource bundle of a build tree: programs in bin/ find resources/ next to it.
file(GLOB bundled CONFIGURE_DEPENDS RELATIVE ${CMAKE_SOURCE_DIR} ${CMAKE_SOURCE_DIR}/resources/*)
foreach(resource ${bundled})
  configure_file(${CMAKE_SOURCE_DIR}/${resource} ${CMAKE_BINARY_DIR}/${resource} COPYONLY)
endforeach()
