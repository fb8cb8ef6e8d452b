// The tool with a stopwatch around its calls, for the share of each kind of work in a whole run:
// linked with the tool's own objects, whose calls of the functions below the linker leads through
// here (--wrap). At its end it prints a line for each kind, the microseconds and the name; what one
// call takes inside another counts for the inner one alone.
#include "platform/system.h"
#include "store/folder_cfg_writer.h"

#include <wx/filename.h>
#include <wx/xml/xml.h>

#include <array>
#include <chrono>
#include <cstdio>
#include <dlfcn.h>

class FolderUpgradeApp;

namespace
{

using Clock = std::chrono::steady_clock;

enum Kind
{
    Rest,
    Load,
    Save,
    Build,
    CopyIcon,
    DesktopIni,
    Registry,
    Log,
    Presets,
    KindCount
};

constexpr std::array<const char*, KindCount> Names = {"the rest",       "loads",
                                                      "library's save", "its document and file",
                                                      "icon copy",      "Desktop.ini, attributes",
                                                      "registry",       "run log",
                                                      "presets"};

class Stopwatch
{
  public:
    ~Stopwatch()
    {
        Switch(Rest);
        for (size_t kind = 0; kind < KindCount; ++kind)
            std::printf(
                "%lld %s\n",
                static_cast<long long>(
                    std::chrono::duration_cast<std::chrono::microseconds>(m_spent[kind]).count()),
                Names[kind]);
    }

    // Returns the kind so far.
    Kind Switch(Kind kind)
    {
        const Clock::time_point now = Clock::now();
        m_spent[m_kind] += now - m_since;
        m_since = now;
        const Kind before = m_kind;
        m_kind = kind;
        return before;
    }

  private:
    std::array<Clock::duration, KindCount> m_spent{};
    Clock::time_point m_since = Clock::now();
    Kind m_kind = Rest;
};

Stopwatch stopwatch;

class Scope
{
  public:
    explicit Scope(Kind kind) : m_before(stopwatch.Switch(kind))
    {
    }

    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

    ~Scope()
    {
        stopwatch.Switch(m_before);
    }

  private:
    Kind m_before;
};

} // namespace

// Defines the wrapper of a function by its linker name; a member function takes its object first.
#define TIMED(kind, result, name, linkerName, parameters, arguments)                               \
    result name##Real parameters asm("__real_" linkerName);                                        \
    result name##Timed parameters asm("__wrap_" linkerName);                                       \
    result name##Timed parameters                                                                  \
    {                                                                                              \
        const Scope scope(kind);                                                                   \
        return name##Real arguments;                                                               \
    }

// The library's own calls of this one, and those of a virtual function, are no business of the
// linker's: they come here since this definition stands before the library's.
bool wxXmlDocument::Load(wxInputStream& stream, const wxString& encoding, int flags)
{
    using Function = bool (*)(wxXmlDocument*, wxInputStream&, const wxString&, int);
    static const auto real = reinterpret_cast<Function>(
        dlsym(RTLD_NEXT, "_ZN13wxXmlDocument4LoadER13wxInputStreamRK8wxStringi"));
    const Scope scope(::Load);
    return real(this, stream, encoding, flags);
}

TIMED(Save, bool, SaveDocument, "_ZNK13wxXmlDocument4SaveER14wxOutputStreami",
      (const wxXmlDocument* document, wxOutputStream& stream, int indentation),
      (document, stream, indentation))
TIMED(
    Build, int, SaveSettings,
    "_Z21SaveHotFolderSettingsRK8wxStringRK17HotFolderSettingsRKSt3mapIS_15JobSettingEntrySt4less"
    "IS_ESaISt4pairIS0_S6_EEERK14HotFolderPathsRK9wxXmlNodeRKS5_IS_18ImposeSettingEntryS8_SaIS9_IS"
    "0_SL_EEERKSt6vectorI16PreflightSettingSaISS_EE",
    (const wxString& path, const HotFolderSettings& settings, const JobSettingTable& jobSettings,
     const HotFolderPaths& paths, const wxXmlNode& filterSetting,
     const ImposeSettingTable& imposeSettings, const PreflightSettingList& preflightSettings),
    (path, settings, jobSettings, paths, filterSetting, imposeSettings, preflightSettings))
TIMED(CopyIcon, bool, CopyFile, "_Z10wxCopyFileRK8wxStringS1_b",
      (const wxString& from, const wxString& to, bool overwrite), (from, to, overwrite))
TIMED(DesktopIni, bool, CreateIni, "_Z16CreateDesktopIniRK8wxStringS1_",
      (const wxString& folder, const wxString& icon), (folder, icon))
TIMED(DesktopIni, bool, RefreshIni, "_Z17RefreshDesktopIniRK8wxStringS1_",
      (const wxString& folder, const wxString& icon), (folder, icon))
TIMED(DesktopIni, DWORD, GetAttributes, "_Z18GetFileAttributesWPKw", (LPCWSTR path), (path))
TIMED(DesktopIni, BOOL, SetAttributes, "_Z18SetFileAttributesWPKwj",
      (LPCWSTR path, DWORD attributes), (path, attributes))
TIMED(Registry, bool, DefaultPath, "_Z28GetDefaultImposeTemplatePathR10wxFileName",
      (wxFileName & folder), (folder))
TIMED(Registry, bool, PreviousPath, "_Z29GetPreviousImposeTemplatePathR10wxFileName",
      (wxFileName & folder), (folder))
TIMED(Log, void, WriteLog, "_Z6RunLogRK8wxStringi", (const wxString& message, int count),
      (message, count))
TIMED(Presets, void, UpdatePresets, "_Z25UpdateJobPresetImposePathRK16FolderUpgradeApp",
      (const FolderUpgradeApp& app), (app))
