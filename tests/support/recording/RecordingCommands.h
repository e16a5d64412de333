// The command stack: keeps what is added, in order, and runs a command when a test types it.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <tessel/tsedcommands.h>

class TsEdCommand
{
public:
    std::wstring group;
    std::wstring globalName;
    std::wstring localName;
    int flags = 0;
    TsEdCommandHandler handler = nullptr;
    TsEdUIContext* uiContext = nullptr;
    int functionCode = 0;
    void* resources = nullptr;
    bool hasResult = false;        // whether the caller asked for the new command
    std::wstring owner;            // the application that was being called
    std::wstring description = {}; // what HELP would tell
    std::wstring usage = {};       // its arguments; empty where it takes none
    TsEdEntries entries = nullptr; // what the Tab key would offer for them
    int status = TSED_COMMAND_OK;
};

class RecordingCommands : public TsEdCommandStack
{
public:
    // Every `addCommand`, with all arguments and the status it got.
    std::vector<TsEdCommand> added;

    // When set, `addCommand` answers this and adds nothing.
    std::optional<int> answerToAdd;

    // Runs the command of that local name, or of that global name after a "_", in any case, with the words
    // after it as its arguments. False when there is none, when it takes no arguments, or when it says that
    // it has failed.
    bool type(const std::wstring& line);
    // What the running command was typed with, and what the last one said of itself; empty for wrong
    // arguments.
    std::vector<std::wstring> arguments;
    std::optional<std::wstring> failure;
    bool has(const std::wstring& localName) const { return find(localName) != nullptr; }

    // The commands that go when their application is unloaded.
    void removeCommandsOf(const std::wstring& applicationPath);

    int addCommand(const wchar_t* group, const wchar_t* globalName, const wchar_t* localName, int flags,
                   TsEdCommandHandler handler, TsEdUIContext* uiContext, int functionCode, void* resources,
                   TsEdCommand** command) override;
    int removeCommand(const wchar_t* group, const wchar_t* globalName) override;
    int removeGroup(const wchar_t* group) override;

    int describe(const std::wstring& group, const std::wstring& globalName, const std::wstring& description);
    int takeArguments(const std::wstring& group, const std::wstring& globalName, const std::wstring& usage);
    int offerEntries(const std::wstring& group, const std::wstring& globalName, TsEdEntries entries);
    // What a command of that local name offers after these arguments.
    std::vector<std::wstring> offered(const std::wstring& name, const std::vector<std::wstring>& typed);
    // What a command of that global name was described with.
    std::wstring descriptionOf(const std::wstring& globalName) const;

private:
    const TsEdCommand* find(const std::wstring& typedName) const;
    int setLine(const std::wstring& group, const std::wstring& globalName, std::wstring TsEdCommand::*line,
                const std::wstring& text);
    int statusOfAdding(const TsEdCommand& command) const;

    std::vector<std::unique_ptr<TsEdCommand>> mCommands; // those that can be typed now
};
