// A step of the run that may fail for lack of memory.
#pragma once

#include "run/run_log.h"

#include <new>

/// Calls the step. What it throws ends this step and not the run, with a line in the run log.
template <typename Step>
void Attempt(const wchar_t* what, const wxString& path, Step step)
{
    const wchar_t* reason = nullptr;
    try
    {
        return step();
    }
    catch (const std::bad_alloc&)
    {
        reason = L"out of memory";
    }
    catch (...)
    {
        reason = L"unexpected error";
    }
    RunLog(wxString::Format(L"%s left as it is (%s): %s", what, reason, path));
}
