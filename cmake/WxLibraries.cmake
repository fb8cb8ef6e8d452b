# wxWidgets as two targets: wx_libraries, base and xml, for every module; and wx_application, which on Windows adds the
# core library with the GUI application class. Elsewhere wxUSE_GUI=0 makes wxApp the console application class, which
# needs no display.
function(add_wx_target name)
    find_package(wxWidgets 3.2 REQUIRED COMPONENTS ${ARGN})
    add_library(${name} INTERFACE)
    # As system headers, because they do not compile without warnings.
    target_include_directories(${name} SYSTEM INTERFACE ${wxWidgets_INCLUDE_DIRS})
    target_compile_options(${name} INTERFACE
        "$<$<COMPILE_LANGUAGE:CXX>:${wxWidgets_CXX_FLAGS}>") # the resource compiler does not know them
    target_compile_definitions(${name} INTERFACE ${wxWidgets_DEFINITIONS} NDEBUG)
    target_link_directories(${name} INTERFACE ${wxWidgets_LIBRARY_DIRS})
    target_link_libraries(${name} INTERFACE ${wxWidgets_LIBRARIES})
endfunction()

add_wx_target(wx_libraries xml base)
if(WIN32)
    add_wx_target(wx_application core xml base)
else()
    add_library(wx_application INTERFACE)
    target_compile_definitions(wx_libraries INTERFACE wxUSE_GUI=0)
endif()
