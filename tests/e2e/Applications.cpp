#include "tests/e2e/Applications.h"

#include <algorithm>
#include <filesystem>

#include <gtest/gtest.h>

namespace
{
constexpr std::size_t kNameColumn = 24;
constexpr std::size_t kFolderColumn = 48;

// The width is in characters, which begin with every byte but 10xxxxxx.
std::string padded(const std::string& text, std::size_t width)
{
    const auto length = static_cast<std::size_t>(
        std::ranges::count_if(text, [](char byte) { return (byte & '\xC0') != '\x80'; }));
    return text + std::string(width - std::min(width, length), ' ');
}
} // namespace

std::string sample(const std::string& name)
{
    return std::string(SAMPLES_FOLDER) + "/" + name;
}

std::string fixtureModule(const std::string& name)
{
    return std::string(FIXTURE_MODULES) + "/" + name;
}

std::string deadly(const HostSession& session, const std::string& way)
{
    const auto path = session.folder() / (way + ".zmb");
    std::filesystem::copy_file(fixtureModule("Deadly.zmb"), path);
    const auto good = session.folder() / "Good.zmb";
    if (!std::filesystem::exists(good))
        std::filesystem::copy_file(fixtureModule("Good.zmb"), good);
    return path;
}

std::string lispFixture(const std::string& name)
{
    return std::string(LISP_FIXTURES) + "/" + name;
}

std::string modrigBundle()
{
    return MODRIG_BUNDLE;
}

std::string inQuotes(const std::string& text)
{
    std::string result = "\"";
    for (const char character : text)
        result += character == '"' ? std::string("\"\"") : std::string(1, character);
    return result + "\"";
}

std::string setInSuite(const std::string& name, const std::string& data)
{
    return std::string("REGISTRY SET ") + kSuiteKey + " " + name + " " + inQuotes(data);
}

std::vector<std::string> byArguments(const std::vector<std::string>& commands)
{
    std::vector<std::string> arguments;
    for (const std::string& command : commands)
        arguments.insert(arguments.end(), {"-c", command});
    return arguments;
}

void storeSuite(const HostSession& session, const Paths& paths)
{
    std::vector<std::string> commands = {setInSuite("NumStartup", std::to_string(paths.size()))};
    for (std::size_t index = 0; index < paths.size(); ++index)
        commands.push_back(setInSuite(std::to_string(index + 1) + "Startup", paths[index]));
    std::vector<std::string> arguments = byArguments(commands);
    arguments.emplace_back("--safe");
    const HostResult result = session.start(arguments);
    ASSERT_EQ(result.exitStatus, 0) << result.output;
}

std::string suiteInFile(const Paths& paths)
{
    std::string text = "Windows Registry Editor Version 5.00\n\n[HKEY_CURRENT_USER\\" +
                       std::string(kSuiteKey) + "]\n\"NumStartup\"=\"" + std::to_string(paths.size()) +
                       "\"\n";
    for (std::size_t index = 0; index < paths.size(); ++index)
        text += "\"" + std::to_string(index + 1) + "Startup\"=\"" + paths[index] + "\"\n";
    return text;
}

void layOutSuite(const HostSession& session, const std::string& place, const std::string& application)
{
    session.folder().write("layout/" + place, suiteInFile({application}));
}

void putOffModrig(const HostSession& session)
{
    const std::string set = std::string("REGISTRY SET ") + kRecordKey;
    const auto result = session.start(
        {"--safe", "-c", set + " Module " + inQuotes(modrigBundle()), "-c", set + " LoadReasons 4"});
    ASSERT_EQ(result.exitStatus, 0) << result.output;
}

std::string listed(const std::string& path, const std::string& state)
{
    const std::filesystem::path file = path;
    return "  " + padded(file.filename(), kNameColumn) + " " + padded(file.parent_path(), kFolderColumn) +
           " " + state + "\n";
}

std::string linkerRefuses(const std::string& path, const std::string& reason)
{
    return "The application \"" + path + "\" is not loaded: " + reason + ".\n";
}

std::string notOfAType(const std::string& path)
{
    return "“" + path + "” is not of a type that can be loaded.";
}

std::string listedAsNotLoaded(const std::vector<NotLoaded>& files)
{
    std::string text = "Not loaded in this session:\n";
    for (const auto& [file, why] : files)
        text += listed(file, why);
    return text;
}

std::string modrigDoesNotKnow(const std::string& path)
{
    return "Message: " + notOfAType(path) + "\n";
}

std::string modrigDoesNotLoad(const std::string& path)
{
    return "Message: “" + path + "” could not be loaded.\n";
}

std::string startSummary(const std::vector<NotLoaded>& files)
{
    std::string text = files.size() == 1 ? "Message: 1 application"
                                         : "Message: " + std::to_string(files.size()) + " applications";
    text += " could not be loaded:\n";
    for (const auto& [file, why] : files)
        text += "  " + (why.starts_with("“" + file) ? "" : file + ": ") + why + "\n";
    return text;
}
