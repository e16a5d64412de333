// The service "TESSEL_REGISTERED_COMMANDS": the commands that a person can type.
#pragma once

#include "tsresbuf.h"
#include "tsrx.h"

class TsEdCommand;   // one command; owned by the host
class TsEdUIContext; // shortcut menus of a command

using TsEdCommandHandler = void (*)();

// Status of the command stack.
inline constexpr int TSED_COMMAND_OK = 0;
inline constexpr int TSED_COMMAND_DUPLICATE = 1; // the group has a command of that global name already
inline constexpr int TSED_COMMAND_INVALID = 2;   // a name is empty or holds white space, or no handler
inline constexpr int TSED_COMMAND_UNKNOWN = 3;

class TESSEL_API TsEdCommandStack : public TsRxObject
{
public:
    static constexpr const wchar_t* kClassName = L"TsEdCommandStack";

    static TsEdCommandStack* cast(TsRxObject* object)
    {
        return object && object->isKindOf(kClassName) ? static_cast<TsEdCommandStack*>(object) : nullptr;
    }

    // Adds a command to a group (made when it is new). Names compare without regard to case; a person may
    // type the local name, or the global name with a leading "_". The strings are copied. The command belongs
    // to the application that adds it and disappears when that is unloaded. `flags` 0 is a plain modal
    // command; `uiContext` and `resources` may be null; `functionCode` -1 means none; `command`, when not
    // null, receives the new command.
    virtual int addCommand(const wchar_t* group, const wchar_t* globalName, const wchar_t* localName,
                           int flags, TsEdCommandHandler handler, TsEdUIContext* uiContext = nullptr,
                           int functionCode = -1, void* resources = nullptr,
                           TsEdCommand** command = nullptr) = 0;

    virtual int removeCommand(const wchar_t* group, const wchar_t* globalName) = 0;

    // Removes every command of the group.
    virtual int removeGroup(const wchar_t* group) = 0;

    bool isKindOf(const wchar_t* className) const override;
};

// Gives a command of an application the one line with which `HELP` tells what it does; the text is copied,
// and goes with the command. TSED_COMMAND_INVALID for an empty text or one with control characters (line
// breaks, too), TSED_COMMAND_UNKNOWN when the group has no such command; what was described before then
// stays. Nothing else depends on a description.
TESSEL_API int tsedDescribeCommand(const wchar_t* group, const wchar_t* globalName,
                                   const wchar_t* description);

// Lets a command of an application be typed with arguments. `usage` says in one line which: `HELP` shows it
// after the command's name. Status and limits are those of `tsedDescribeCommand`. A command for which this
// was not called fails when it is typed with arguments.
TESSEL_API int tsedTakeArguments(const wchar_t* group, const wchar_t* globalName, const wchar_t* usage);

// The arguments that the running command was typed with, as TS_STRING values in their order, without the
// quotes that kept blanks together; null when there are none, or when no command of the caller's runs. The
// caller frees the list with `tsutRelRb`.
TESSEL_API TsResultBuffer* tsedCommandArguments();

// Lets the Tab key offer what stands in a list of the application's, at the places of the usage that say
// `entry`. The function is called while a person types, with what was typed before in
// `tsedCommandArguments()`, and answers TS_STRING values or null; the host frees them. It must not speak.
// Status as with `tsedTakeArguments`, TSED_COMMAND_INVALID for null.
using TsEdEntries = TsResultBuffer* (*)();
TESSEL_API int tsedOfferEntries(const wchar_t* group, const wchar_t* globalName, TsEdEntries entries);

// Makes the running command one that has failed: when its handler has returned, the host tells the sentence
// as it tells its own errors, and a script counts the line as failed. Null stands for arguments that the
// command does not take: the host then says how it is typed. The last call counts; outside of a command
// nothing happens.
TESSEL_API void tsedFailCommand(const wchar_t* sentence);
