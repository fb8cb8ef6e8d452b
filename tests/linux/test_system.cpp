#include "tests/test_system.h"

#include <cstdlib>
#include <stdexcept>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace
{

// The text as one word for a shell.
Text Quoted(const Text& text)
{
    return "'" + text + "' ";
}

// The limits of a run, as the beginning of its command. A program with sanitizers needs more.
const Text& Limits()
{
    static const Text program = ReadFile(ProgramDir() / "FolderUpgrade");
    static const Text limits = program.find("__asan_init") == Text::npos
                                   ? "ulimit -v 700000; exec timeout 10 "
                                   : "exec timeout 120 ";
    return limits;
}

} // namespace

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
    if (!mkdtemp(pattern.data()))
        throw std::runtime_error("no temporary folder");
    fs::permissions(pattern, fs::perms(0755));
    return pattern;
}

fs::path UserDataDir(const fs::path& root)
{
    return root / "user data";
}

fs::path MachineDataDir(const fs::path& root)
{
    return root / "machine data";
}

void SetRegistry(const std::vector<Text>& /*hives*/)
{
}

RunResult RunToEnd(const Command& command, const fs::path& root, const fs::path& /*log*/)
{
    Text line = Limits();
    line += command.asOtherUser && geteuid() == 0
                ? "setpriv --reuid=nobody --regid=nogroup --clear-groups env "
                : "env ";
    for (const auto& [name, value] : command.environment)
        line += name + "=" + Quoted(value);
    line += "LC_ALL=C XDG_CONFIG_HOME=" + Quoted(UserDataDir(root)) +
            "XDG_CONFIG_DIRS=" + Quoted(MachineDataDir(root).string() + ":/nowhere") +
            Quoted(command.program);
    for (const Text& argument : command.arguments)
        line += Quoted(argument);
    const fs::path output = root / "output";
    const fs::path errors = root / "errors";
    const int status = std::system((line + ">" + Quoted(output) + "2>" + Quoted(errors)).c_str());
    return {WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status), ReadFile(output),
            ReadFile(errors)};
}

bool IsSymbolicLink(const fs::path& path)
{
    return fs::is_symlink(path);
}

void MakeLink(const fs::path& target, const fs::path& link)
{
    fs::create_symlink(target, link);
}

void MakeFifo(const fs::path& path)
{
    if (mkfifo(path.c_str(), 0644) != 0)
        throw std::runtime_error("no FIFO at " + path.string());
}

void RemoveTree(const fs::path& path)
{
    std::error_code ignored;
    fs::remove_all(path, ignored);
}

void GiveAway(const std::vector<fs::path>& folders)
{
    Text command = "chown -Rh nobody:nogroup ";
    for (const fs::path& folder : folders)
        command += fs::exists(folder) ? Quoted(folder) : "";
    if (geteuid() == 0 && std::system(command.c_str()) != 0)
        throw std::runtime_error("cannot give files away");
}

void Refuse(const fs::path& path, char letter)
{
    if (letter != 'X')
        fs::permissions(path, letter == '0' ? fs::perms::none : fs::perms::owner_exec);
    else if (chown(path.c_str(), 0, 0) != 0)
        throw std::runtime_error("cannot give away " + path.string());
}

std::shared_ptr<void> UseAlone(const fs::path& /*path*/)
{
    throw std::logic_error("here, files are not locked");
}
