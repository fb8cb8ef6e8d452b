#include "tests/check_report.h"

#include "tests/text_files.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cctype>
#include <sstream>

namespace
{

std::string Lower(std::string text)
{
    std::transform(text.begin(), text.end(), text.begin(), ::tolower);
    return text;
}

const std::string Change = "  change   ";
const std::string Problem = "  problem  ";

// The place of the change that this line reports in the block with that title.
std::string PlaceOf(const Workstation& workstation, const std::string& title,
                    const std::string& change)
{
    const std::string hot = workstation.Expand("{hot}{/}");
    if (!StartsWith(title, hot))
    {
        std::string place = "user/ORX/JPData/" + change.substr(0, change.find(": "));
        std::replace(place.begin(), place.end(), '\\', '/');
        return title == "Job presets" ? place : "(no place) " + title + ": " + change;
    }
    const std::string folder = "hot/" + title.substr(hot.size());
    const std::string name = change.substr(0, change.find(':'));
    if (name == "hot folder")
        return folder + "#";
    if (name == "Desktop.ini")
        return folder + "/" + name + (StartsWith(change, "Desktop.ini: attributes") ? "#" : "");
    return folder + "/[P]/" + name;
}

// The place, with the target of a link replaced by the place of the link.
std::string ReachedOverLinks(std::string place, const Files& files)
{
    for (const auto& [link, text] : files)
    {
        const std::string target =
            StartsWith(text, "{link:") ? text.substr(6, text.size() - 7) + "/" : "";
        if (!target.empty() && StartsWith(place, target))
            return ReachedOverLinks(link + place.substr(target.size()), files);
    }
    return place;
}

// The relevant part of the text at a place. Wine does not show that a directory is read-only.
std::string Meaning(const std::string& place, const std::string& text)
{
    const bool isHotFolder =
        place.back() == '#' && std::count(place.begin(), place.end(), '/') == 1;
    if (IsWindowsProgram() && isHotFolder && StartsWith(text, "R"))
        return text.substr(1);
    return place.find("Desktop.ini") != std::string::npos && place.back() != '#'
               ? ProfileMeaning(text)
               : text;
}

} // namespace

CheckReport::CheckReport(const Workstation& workstation, const RunResult& run) : text(run.output)
{
    std::istringstream lines(text);
    std::string title;
    for (std::string line; std::getline(lines, line);)
    {
        line.erase(line.find_last_not_of("\r") + 1);
        if (StartsWith(line, Problem))
            ++problems;
        else if (StartsWith(line, Change))
        {
            const std::string change = line.substr(Change.size());
            changes.insert(PlaceOf(workstation, title, change));
            if (change == "Desktop.ini: new")
                changes.insert(PlaceOf(workstation, title, change) + "#");
        }
        else if (!line.empty() && line[0] != ' ')
            title = line;
    }
    EXPECT_EQ(problems > 0      ? 2
              : changes.empty() ? 0
                                : 1,
              run.process.exitStatus)
        << text << run.libraryLog;
    EXPECT_EQ("", run.libraryLog);
}

std::set<std::string> ChangedPlaces(const Files& before, const Files& after)
{
    std::set<std::string> places;
    const auto add = [&](const Files& left, const Files& right)
    {
        for (const auto& [place, text] : left)
        {
            const auto found = right.find(place);
            const bool isSame =
                found != right.end() && Meaning(place, text) == Meaning(place, found->second);
            const size_t icon = place.find(".ico#");
            if (!isSame && place.find("ORX_Installers") == std::string::npos)
                places.insert(ReachedOverLinks(
                    icon == std::string::npos ? place : place.substr(0, icon + 4), before));
        }
    };
    add(before, after);
    add(after, before);
    return places;
}

std::string ProfileMeaning(const std::string& profile)
{
    std::map<std::string, std::string> values;
    const bool isUtf16 = StartsWith(profile, "\xFF\xFE");
    std::string text = profile.substr(isUtf16 ? 2 : 0);
    text.erase(std::remove(text.begin(), text.end(), '\0'),
               text.end()); // UTF-16 texts here are all ASCII
    std::istringstream lines(text);
    std::string section;
    for (std::string line; std::getline(lines, line);)
    {
        line.erase(line.find_last_not_of(" \t\r") + 1);
        const size_t sign = line.find('=');
        if (line.empty() || line[0] == ';')
            continue;
        if (line[0] == '[')
            section = Lower(line);
        else if (sign != std::string::npos && Lower(line.substr(0, sign)) != "iconresource")
            values.emplace(section +
                               Lower(line.substr(0, line.find_last_not_of(' ', sign - 1) + 1)),
                           line.substr(sign + 1));
    }
    std::string meaning = isUtf16 ? "in UTF-16\n" : "";
    for (const auto& [key, value] : values)
        meaning += key + "=" + value + "\n";
    return meaning;
}
