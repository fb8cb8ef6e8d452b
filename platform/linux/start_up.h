// What has to be set up before the library starts.
#pragma once

/// Makes file names UTF-8 whatever the environment says: the library never sets a locale for a
/// console application, and in the "C" locale it loses names that are not ASCII, including those of
/// the standard folders and the executable. Makes a write fail where the system would end the
/// process: at the longest file that it permits, and to a pipe that nobody reads. A static object
/// does both before main().
struct StartUp
{
    StartUp();
};
