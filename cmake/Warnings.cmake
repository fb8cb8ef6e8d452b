# For our own code: all warnings, as errors.
add_library(warnings INTERFACE)
if(MSVC)
    target_compile_options(warnings INTERFACE "$<$<COMPILE_LANGUAGE:CXX>:/W4;/WX>")
else()
    target_compile_options(warnings INTERFACE
        "$<$<COMPILE_LANGUAGE:CXX>:-Wall;-Wextra;-Wpedantic;-Wconversion;-Wshadow;-Werror>")
endif()
