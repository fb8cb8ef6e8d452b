# For our own code: all warnings, as errors.
set(CMAKE_COMPILE_WARNING_AS_ERROR ON)
add_library(warnings INTERFACE)
if(MSVC)
    target_compile_options(warnings INTERFACE "$<$<COMPILE_LANGUAGE:CXX>:/W4>")
else()
    target_compile_options(warnings INTERFACE
        "$<$<COMPILE_LANGUAGE:CXX>:-Wall;-Wextra;-Wpedantic;-Wconversion;-Wshadow>")
endif()
