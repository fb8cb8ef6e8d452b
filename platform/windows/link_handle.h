// What an open handle is that of.
#pragma once

#include "platform/system.h"

/// 0 if the system does not say.
inline DWORD AttributesOf(HANDLE handle)
{
    BY_HANDLE_FILE_INFORMATION information = {};
    return GetFileInformationByHandle(handle, &information) != 0 ? information.dwFileAttributes : 0;
}

/// For a handle that was opened with FILE_FLAG_OPEN_REPARSE_POINT: whether it is that of a reparse
/// point whose tag is a name surrogate. True if the system does not say.
inline bool IsLinkHandle(HANDLE handle)
{
    FILE_ATTRIBUTE_TAG_INFO information = {};
    return GetFileInformationByHandleEx(handle, FileAttributeTagInfo, &information,
                                        sizeof information) == 0 ||
           ((information.FileAttributes & FILE_ATTRIBUTE_REPARSE_POINT) != 0 &&
            IsReparseTagNameSurrogate(information.ReparseTag));
}
