#include "tests/workstation.h"

#include <array>
#include <cctype>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <fstream>
#include <grp.h>
#include <sstream>
#include <stdexcept>
#include <sys/stat.h>
#include <sys/wait.h>
#include <sys/xattr.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace
{

constexpr uid_t OtherUser = 65534;
constexpr int TimeLimitSeconds = 120;
const char* const AttributeName = "user.DOSATTRIB";

std::string ReadFile(const fs::path& path)
{
    std::ifstream file(path, std::ios::binary);
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

void WriteFile(const fs::path& path, const std::string& text)
{
    fs::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary) << text;
}

void ReplaceAll(std::string& text, const std::string& from, const std::string& to)
{
    for (size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
}

std::string WithDoubled(const std::string& text, char character)
{
    std::string result;
    for (const char each : text)
        result += std::string(each == character ? 2 : 1, each);
    return result;
}

// UTF-8 as UTF-16LE with a byte-order mark; of characters beyond U+FFFF there are none.
std::string ToUtf16(const std::string& text)
{
    std::string result = "\xFF\xFE";
    for (size_t i = 0; i < text.size();)
    {
        const auto lead = static_cast<unsigned char>(text[i]);
        const size_t length = lead < 0x80 ? 1 : lead < 0xE0 ? 2 : 3;
        unsigned code = length == 1 ? lead : lead & (length == 2 ? 0x1FU : 0x0FU);
        for (size_t k = 1; k < length; ++k)
            code = code << 6 | (static_cast<unsigned char>(text[i + k]) & 0x3FU);
        result += {static_cast<char>(code & 0xFF), static_cast<char>(code >> 8)};
        i += length;
    }
    return result;
}

unsigned long StoredAttributes(const fs::path& path)
{
    std::array<char, 16> text{};
    getxattr(path.c_str(), AttributeName, text.data(), text.size() - 1);
    return std::strtoul(text.data(), nullptr, 16);
}

std::string Letters(const fs::path& path)
{
    struct stat status = {};
    stat(path.c_str(), &status);
    const unsigned long stored = StoredAttributes(path);
    const bool isDirectory = S_ISDIR(status.st_mode);
    const bool isReadOnly = isDirectory ? (stored & 1) != 0 : (status.st_mode & 0222) == 0;
    return std::string(isReadOnly ? "R" : "") + ((stored & 4) != 0 ? "S" : "");
}

[[noreturn]] void Become(const fs::path& program, const std::vector<std::string>& arguments,
                         int errorFile, bool asOtherUser)
{
    dup2(errorFile, STDERR_FILENO);
    if (asOtherUser && geteuid() == 0 &&
        (setgroups(0, nullptr) != 0 || setgid(OtherUser) != 0 || setuid(OtherUser) != 0))
        _exit(126);
    alarm(TimeLimitSeconds);
    std::vector<char*> argv{const_cast<char*>(program.c_str())};
    for (const std::string& argument : arguments)
        argv.push_back(const_cast<char*>(argument.c_str()));
    argv.push_back(nullptr);
    execv(program.c_str(), argv.data());
    _exit(127);
}

} // namespace

bool IsWindowsProgram()
{
    return false;
}

Workstation::Workstation()
{
    std::string pattern = (fs::temp_directory_path() / "work station XXXXXX").string();
    if (!mkdtemp(pattern.data()))
        throw std::runtime_error("no temporary folder");
    m_root = pattern;
    fs::permissions(m_root, fs::perms(0755));
    m_hostDirs = {{"hot", m_root / "Hot Folders"},
                  {"user", m_root / "user data"},
                  {"machine", m_root / "machine data"},
                  {"tool", m_root / "Tool Größe"}};
    for (const auto& [name, directory] : m_hostDirs)
        m_tokens["{" + name + "}"] = directory.string();
    m_tokens["{app}"] = (m_root / "Apps ä").string();
    m_tokens["{previous}"] = (m_root / "Vorige 版").string();
    m_tokens["{default}"] = m_tokens["{app}"] + "/template";
    m_tokens["{/}"] = "/";
    // In capitals as the registry editor's text has them.
    for (const auto& [token, value] : Files(m_tokens))
    {
        std::string capitals = token;
        for (char& character : capitals)
            character = static_cast<char>(std::toupper(static_cast<unsigned char>(character)));
        m_tokens[token == "{/}" ? "{/2}" : capitals] = WithDoubled(value, '\\');
    }

    const fs::path built = TOOL_DIR;
    fs::create_directories(m_hostDirs["tool"]);
    fs::copy(built / "FolderUpgrade", m_hostDirs["tool"]);
    fs::copy(built / "BundleIcons", m_hostDirs["tool"] / "BundleIcons");
    for (const auto& icon : fs::directory_iterator(built / "BundleIcons"))
        fs::copy(icon, m_hostDirs["tool"]);
}

Workstation::~Workstation()
{
    std::error_code ignored;
    for (auto entry = fs::recursive_directory_iterator(m_root, ignored);
         entry != fs::recursive_directory_iterator(); entry.increment(ignored))
    {
        if (entry->is_directory(ignored))
            fs::permissions(entry->path(), fs::perms::owner_all, fs::perm_options::add, ignored);
    }
    fs::remove_all(m_root, ignored);
}

fs::path Workstation::HostPath(const std::string& place) const
{
    const size_t slash = place.find('/');
    std::string rest = place.substr(slash + 1);
    ReplaceAll(rest, "[P]", "[_ORX_HotFolder_]");
    return m_hostDirs.at(place.substr(0, slash)) / rest;
}

std::string Workstation::Expand(std::string text) const
{
    for (const auto& [token, value] : m_tokens)
        ReplaceAll(text, token, value);
    const std::string utf16 = "{utf16}";
    if (text.compare(0, utf16.size(), utf16) == 0)
        return ToUtf16(text.substr(utf16.size()));
    const size_t icon = text.find("{icon:");
    if (icon != std::string::npos)
        return ReadFile(fs::path(TOOL_DIR) / (text.substr(icon + 6, text.find('}') - icon - 6)));
    return text;
}

void Workstation::SetAttributes(const std::string& place, const std::string& letters) const
{
    const fs::path path = HostPath(place);
    const bool isDirectory = fs::is_directory(path);
    const auto has = [&](char letter)
    {
        return letters.find(letter) != std::string::npos;
    };
    const unsigned stored = (has('S') ? 4U : 0U) | (has('R') && isDirectory ? 1U : 0U);
    const std::string text = "0x" + std::to_string(stored);
    if (stored != 0 && setxattr(path.c_str(), AttributeName, text.data(), text.size(), 0) != 0)
        throw std::runtime_error("no extended attributes in " + m_root.string());
    if (has('X') && chown(path.c_str(), 0, 0) != 0)
        throw std::runtime_error("only root can give files away");
    if (has('R') && !isDirectory)
        fs::permissions(path, fs::perms(0444));
    if (has('0'))
        fs::permissions(path, fs::perms::none);
}

void Workstation::LayOut(const Files& files)
{
    for (const auto& [place, text] : files)
    {
        if (place.back() == '/')
            fs::create_directories(HostPath(place));
        else if (place.back() != '#')
            WriteFile(HostPath(place), Expand(text));
    }
    if (geteuid() == 0)
    {
        for (const auto& entry : fs::recursive_directory_iterator(m_root))
            lchown(entry.path().c_str(), OtherUser, OtherUser);
    }
    for (const auto& [place, text] : files)
    {
        if (place.back() == '#')
            SetAttributes(place.substr(0, place.size() - 1), text);
    }
}

RunResult Workstation::Start(const std::vector<std::string>& arguments, bool asOtherUser)
{
    const fs::path errors = m_root / "errors";
    const int errorFile =
        open(errors.c_str(), O_RDWR | O_CREAT | O_TRUNC | O_CLOEXEC, S_IRUSR | S_IWUSR);
    setenv("XDG_CONFIG_HOME", m_hostDirs["user"].c_str(), 1);
    setenv("XDG_CONFIG_DIRS", (m_hostDirs["machine"].string() + ":/nowhere").c_str(), 1);
    setenv("LC_ALL", "C", 1);
    const pid_t child = fork();
    if (child == 0)
        Become(m_hostDirs["tool"] / "FolderUpgrade", arguments, errorFile, asOtherUser);
    int status = 0;
    waitpid(child, &status, 0);
    close(errorFile);
    RunResult run;
    run.exitStatus = WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
    run.libraryLog = ReadFile(errors);
    return run;
}

Files Workstation::Snapshot() const
{
    Files files;
    for (const auto& [name, directory] : m_hostDirs)
    {
        if (!fs::exists(directory))
            continue;
        for (const auto& entry : fs::recursive_directory_iterator(directory))
        {
            std::string place = name + "/" + fs::relative(entry.path(), directory).string();
            ReplaceAll(place, "[_ORX_HotFolder_]", "[P]");
            const std::string letters = Letters(entry.path());
            if (!letters.empty())
                files[place + "#"] = letters;
            if (entry.is_directory())
                files[place + "/"];
            else
                files[place] = ReadFile(entry.path());
        }
    }
    return files;
}
