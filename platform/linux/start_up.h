// What has to be so before the library starts.
#pragma once

/// File names are UTF-8 whatever the environment says: the library never sets a locale for a
/// console application, and in the "C" locale it loses names that are not ASCII, those of the
/// standard folders, of the executable and of the command line. The stack may grow to 64 MiB, as
/// far as the hard limit lets it. Every object of this type makes it so; one that is static does
/// before main().
struct StartUp
{
    StartUp();
};
