# For our own code: all warnings, as errors.
set(CMAKE_COMPILE_WARNING_AS_ERROR ON)
add_library(warnings INTERFACE)
target_compile_options(warnings INTERFACE
    "$<$<COMPILE_LANGUAGE:CXX>:-Wall;-Wextra;-Wpedantic;-Wconversion;-Wshadow>")
