# Packs the staged files so that one commit gives identical zip files, whenever, wherever and by whom it is packed.
# CPack's own zip files depend on the order of the files on the disk and on the user's ID.
execute_process(
    COMMAND git -C ${CMAKE_CURRENT_LIST_DIR} log -1 --format=%ct
    OUTPUT_VARIABLE date OUTPUT_STRIP_TRAILING_WHITESPACE ERROR_QUIET RESULT_VARIABLE failed)
if(failed OR NOT date)
    set(date 315619200) # no commit known: 2 January 1980, the first day that a zip file can store in every time zone
endif()
set(ENV{SOURCE_DATE_EPOCH} ${date})
set(ENV{TZ} UTC0)

file(GLOB_RECURSE files LIST_DIRECTORIES false RELATIVE ${CPACK_TEMPORARY_DIRECTORY}
     ${CPACK_TEMPORARY_DIRECTORY}/*)
set(package ${CPACK_TOPLEVEL_DIRECTORY}/${CPACK_PACKAGE_FILE_NAME}.zip)
file(REMOVE ${package})
find_program(zip zip)
find_program(touch touch)
function(run)
    execute_process(COMMAND ${ARGV} WORKING_DIRECTORY ${CPACK_TEMPORARY_DIRECTORY}
                    COMMAND_ERROR_IS_FATAL ANY)
endfunction()

if(NOT "${CPACK_FOLDER_UPGRADE_SIGN_COMMAND}" STREQUAL "")
    file(GLOB programs ${CPACK_TEMPORARY_DIRECTORY}/*.exe)
    if(NOT programs)
        message(FATAL_ERROR "FOLDER_UPGRADE_SIGN_COMMAND is given, but no program for Windows is packed")
    endif()
    foreach(program IN LISTS programs)
        run(${CPACK_FOLDER_UPGRADE_SIGN_COMMAND} ${program})
    endforeach()
endif()

if(zip AND touch)
    run(${touch} --date=@${date} ${files})
    run(${zip} -X -q ${package} ${files})
elseif(NOT CMAKE_HOST_WIN32)
    message(FATAL_ERROR "Packing needs zip and touch (Debian's packages zip and coreutils)")
else()
    message(STATUS "Without zip and touch the package depends on who packs it")
    run(${CMAKE_COMMAND} -E tar cf ${package} --format=zip ${files})
endif()
set(CPACK_EXTERNAL_BUILT_PACKAGES ${package})
