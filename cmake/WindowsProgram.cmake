# What a program for Windows needs in addition to its sources.

# Resources: the icon, the manifest and the version, which has DESCRIPTION and the target's name.
function(add_windows_resources target description)
    set(templates ${CMAKE_SOURCE_DIR}/cmake/windows)
    set(icons ${CMAKE_SOURCE_DIR}/appearance/icons)
    set(output ${CMAKE_CURRENT_BINARY_DIR}/windows)
    get_target_property(has_windows ${target} WIN32_EXECUTABLE)
    foreach(kind rc manifest)
        configure_file(${templates}/program.${kind}.in ${output}/${target}.${kind} @ONLY)
    endforeach()
    target_include_directories(${target} PRIVATE ${output} ${icons})
    target_sources(${target} PRIVATE ${output}/${target}.rc)
    set_source_files_properties(${output}/${target}.rc PROPERTIES
        OBJECT_DEPENDS "${icons}/hf_folder.ico;${output}/${target}.manifest")
endfunction()

# The module platform does what has to be done before main().
function(harden_windows_program target)
    target_link_options(${target} PRIVATE LINKER:--dynamicbase LINKER:--nxcompat LINKER:--high-entropy-va)
endfunction()

# Moves the symbols of the release into a separate file, <program>.debug, beside the program.
function(split_symbols target)
    if(NOT CMAKE_BUILD_TYPE STREQUAL Release)
        return()
    endif()
    set(program $<TARGET_FILE:${target}>)
    # objcopy's output has no date, like the linker's.
    set(objcopy ${CMAKE_COMMAND} -E env SOURCE_DATE_EPOCH=0 ${CMAKE_OBJCOPY})
    add_custom_command(TARGET ${target} POST_BUILD
        COMMAND ${objcopy} --only-keep-debug ${program} ${program}.debug
        COMMAND ${objcopy} --strip-all --add-gnu-debuglink=${program}.debug ${program}
        VERBATIM)
    set_property(TARGET ${target} APPEND PROPERTY ADDITIONAL_CLEAN_FILES ${program}.debug)
endfunction()
