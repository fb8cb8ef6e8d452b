#include "tests/workstation.h"

#include <cstdlib>
#include <sys/wait.h>
#include <unistd.h>

static Text Quoted(const Text& text)
{
    return "'" + text + "' ";
}

bool IsWine()
{
    return false;
}

fs::path ProgramDir()
{
    const char* const given = std::getenv("FOLDER_UPGRADE_PROGRAMS");
    return given ? given : PROGRAM_DIR;
}

fs::path NewRoot()
{
    Text pattern = (fs::temp_directory_path() / "work station XXXXXX").string();
    fs::permissions(mkdtemp(pattern.data()), fs::perms(0755)); // another user has to enter it
    return pattern;
}

fs::path DataDir(const Text& name, const fs::path& root)
{
    return root / (name + " data");
}

RunResult Workstation::Start(const Text& program, const std::vector<Text>& arguments,
                             const Files& variables, int /*killAfter*/) const
{
    // A program with sanitizers needs more.
    static const bool isSanitized =
        ReadFile(ProgramDir() / "FolderUpgrade").find("__asan_init") != Text::npos;
    Text line = isSanitized ? "exec timeout 120 " : "ulimit -v 700000; exec timeout 10 ";
    line += m_asOtherUser && geteuid() == 0
                ? "setpriv --reuid=nobody --regid=nogroup --clear-groups env "
                : "env ";
    for (const auto& [name, value] : variables)
        line += name + "=" + Quoted(value);
    line += "LC_ALL=C XDG_CONFIG_HOME=" + Quoted(HostPath("user")) +
            "XDG_CONFIG_DIRS=" + Quoted(HostPath("machine").string() + ":/nowhere") +
            Quoted(HostPath("tool/" + program));
    for (const Text& argument : arguments)
        line += Quoted(Expand(argument));
    line += ">" + Quoted(m_root / "output") + "2>" + Quoted(m_root / "errors");
    const int status = std::system(line.c_str());
    return {WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status),
            ReadFile(m_root / "output"), ReadFile(m_root / "errors")};
}

void MakeLink(const fs::path& target, const fs::path& link)
{
    fs::create_symlink(target, link);
}

void RemoveTree(const fs::path& path)
{
    std::error_code ignored;
    fs::remove_all(path, ignored);
}

void GiveAway(const fs::path& folder)
{
    if (geteuid() == 0 && std::system(("chown -Rh nobody:nogroup " + Quoted(folder)).c_str()) != 0)
        throw std::runtime_error("cannot give files away");
}

void Refuse(const fs::path& path, char letter)
{
    if (letter != 'X')
        fs::permissions(path, letter == '0' ? fs::perms::none : fs::perms::owner_exec);
    else if (chown(path.c_str(), 0, 0) != 0)
        throw std::runtime_error("cannot give away " + path.string());
}
