# What all targets of the project have in common.

include_guard()

# Language level, visibility and warnings of our own sources. Nobody is to exchange a library's
# operations for others when it is loaded, so it calls its own directly. GCC 12 sees an overlap in its
# own library's string concatenation, so that one warning is off.
function(kel_settings target)
  set_target_properties(${target} PROPERTIES
    CXX_STANDARD 20 CXX_STANDARD_REQUIRED ON CXX_EXTENSIONS OFF
    CXX_VISIBILITY_PRESET hidden VISIBILITY_INLINES_HIDDEN ON
    POSITION_INDEPENDENT_CODE ON)
  target_compile_options(${target} PRIVATE -fno-semantic-interposition
    -Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wformat=2 -Wnon-virtual-dtor -Wold-style-cast
    -Wcast-qual -Woverloaded-virtual $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>
    $<$<BOOL:${KEL_WARNINGS_AS_ERRORS}>:-Werror>)
endfunction()

# Version, soname and exported names of a library. Hidden visibility alone would still export
# instantiations of the Standard Library's templates, so a version script lets through our own.
function(kel_library_settings target)
  kel_settings(${target})
  target_compile_features(${target} PUBLIC cxx_std_17)
  set_target_properties(${target} PROPERTIES
    VERSION ${PROJECT_VERSION} SOVERSION ${PROJECT_VERSION_MAJOR}
    LINK_DEPENDS "${KEL_EXPORT_MAP}")
  get_target_property(type ${target} TYPE)
  if(type STREQUAL "SHARED_LIBRARY")
    target_link_options(${target} PRIVATE "LINKER:--version-script=${KEL_EXPORT_MAP}")
  endif()
endfunction()

set(KEL_EXPORT_MAP "${CMAKE_CURRENT_LIST_DIR}/exports.map")
