# wxWidgets as the target wx_libraries: base and xml, and on Windows core, for the GUI application
# class. Elsewhere wxUSE_GUI=0 makes wxApp the console application class, which needs no display.
if(WIN32)
    set(wx_components core xml base)
else()
    set(wx_components xml base)
endif()
find_package(wxWidgets 3.1 REQUIRED COMPONENTS ${wx_components})

add_library(wx_libraries INTERFACE)
# As system headers: they do not stand our warnings.
target_include_directories(wx_libraries SYSTEM INTERFACE ${wxWidgets_INCLUDE_DIRS})
target_compile_options(wx_libraries INTERFACE
    "$<$<COMPILE_LANGUAGE:CXX>:${wxWidgets_CXX_FLAGS}>") # the resource compiler knows none of them
target_compile_definitions(wx_libraries INTERFACE ${wxWidgets_DEFINITIONS} NDEBUG)
target_link_directories(wx_libraries INTERFACE ${wxWidgets_LIBRARY_DIRS})
target_link_libraries(wx_libraries INTERFACE ${wxWidgets_LIBRARIES})
if(NOT WIN32)
    target_compile_definitions(wx_libraries INTERFACE wxUSE_GUI=0)
endif()
