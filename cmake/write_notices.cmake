# Installs THIRD-PARTY-NOTICES.txt: the licences of what is linked into the Windows programs, copied from Debian's
# packages. wx_prefix is the folder that windows/build_wxwidgets.sh has printed.
set(notices $ENV{DESTDIR}${CMAKE_INSTALL_PREFIX}/THIRD-PARTY-NOTICES.txt)
file(WRITE ${notices} "The programs contain parts of the works below. Each text is the one in Debian's package.\n")

function(add_notices title file)
    string(REPEAT = 80 line)
    file(READ ${file} text)
    file(APPEND ${notices} "\n\n${line}\n${title}\n${line}\n\n${text}")
endfunction()

add_notices("wxWidgets" ${wx_prefix}/licences/wxwidgets3.2)
add_notices("Expat" ${wx_prefix}/licences/expat)
add_notices("MinGW-w64's runtime and headers, winpthreads" /usr/share/doc/mingw-w64-x86-64-dev/copyright)
add_notices("GCC's runtime, libgcc and libstdc++" /usr/share/doc/g++-mingw-w64-x86-64-posix/copyright)

# The files on a Debian system that these texts refer to are appended.
file(READ ${notices} text)
string(REGEX MATCHALL "/usr/share/common-licenses/[A-Za-z0-9.-]*[A-Za-z0-9]" names "${text}")
set(licences "")
foreach(name IN LISTS names)
    file(REAL_PATH ${name} licence) # "GPL" links to the newest
    list(APPEND licences ${licence})
endforeach()
list(REMOVE_DUPLICATES licences)
foreach(licence IN LISTS licences)
    cmake_path(GET licence FILENAME title)
    add_notices(${title} ${licence})
endforeach()
