// What has to be set up before the library starts.
#pragma once

/// Makes file names UTF-8 whatever the environment says: the library never sets a locale for a
/// console application, and in the "C" locale it loses names that are not ASCII, including those of
/// the standard folders and the executable. Lets the stack grow to 64 MiB, as far as the hard limit
/// allows. A static object does both before main().
struct StartUp
{
    StartUp();
};
