# The target package: FolderUpgrade-<version>-<system>.zip, which holds only what is installed.

# The statically linked Windows programs contain the work of others. Elsewhere, and with other toolchains, no notices
# are added.
if(MINGW)
    install(CODE "set(wx_prefix \"${FOLDER_UPGRADE_WX_PREFIX}\")")
    install(SCRIPT ${CMAKE_CURRENT_LIST_DIR}/write_notices.cmake)
endif()

# Signing. The command is called for each program of the package with the program's path as its last argument, before
# packing; it has to sign in place, and to fail if it cannot. On Windows, for example:
#
#     -D "FOLDER_UPGRADE_SIGN_COMMAND=signtool;sign;/fd;sha256;/a"
#
# osslsigncode writes to another file, so it needs a script:
#
#     #!/bin/sh -e
#     osslsigncode sign -key key.pem -certs certificate.pem -h sha256 -in "$1" -out "$1.signed"
#     mv "$1.signed" "$1"
#
# and this makes a test certificate:
#
#     openssl req -x509 -newkey rsa:2048 -nodes -days 30 -subj /CN=Trial -addext extendedKeyUsage=codeSigning \
#         -keyout key.pem -out certificate.pem
#
# The programs in the build folder and their symbol files stay as they are. Add a time stamp (signtool /tr, osslsigncode
# -ts), or the signature expires with the certificate. Whoever builds an installer signs it with the same command.
set(FOLDER_UPGRADE_SIGN_COMMAND "" CACHE STRING
    "Command and arguments, as a list, that sign the program whose path is added; empty for none")
set(CPACK_FOLDER_UPGRADE_SIGN_COMMAND ${FOLDER_UPGRADE_SIGN_COMMAND})

set(CPACK_GENERATOR External)
set(CPACK_EXTERNAL_ENABLE_STAGING ON)
set(CPACK_EXTERNAL_PACKAGE_SCRIPT ${CMAKE_CURRENT_LIST_DIR}/write_zip.cmake)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
    OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)
set(CPACK_VERBATIM_VARIABLES ON)
include(CPack)
