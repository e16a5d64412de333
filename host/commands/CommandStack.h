// The commands that a person can type: those of the host and those that applications register.
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <tessel/tsedcommands.h>

#include "host/text/Result.h"

namespace tessel
{
class CallingApplication;
struct CommandText;

// The global name may be typed with this in front, whatever language the local names are in.
inline constexpr wchar_t kGlobalNameMark = L'_';

class CommandStack : public TsEdCommandStack
{
public:
    using Arguments = std::vector<std::wstring>;
    using BuiltIn = std::function<Result<>(const Arguments&)>;
    using Names = std::pair<std::wstring, std::wstring>; // a global and a local name

    struct Description
    {
        std::wstring group;
        std::wstring name;    // what a person types
        std::wstring usage;   // the arguments, as in `CommandText`
        std::wstring summary; // one line; empty where an application has given none
        std::wstring example = {};
    };
    static Description descriptionOf(const CommandText& text);
    static Description descriptionOf(const TsEdCommand& command);

    // Shared: a handler may remove the command that runs it.
    using Command = std::shared_ptr<const TsEdCommand>;

    // `calls` knows whose a command is that is added.
    explicit CommandStack(const CallingApplication& calls);
    ~CommandStack() override;

    // A command of the host itself: its arguments follow on the line, and no application can remove it.
    void addBuiltIn(const Description& description, BuiltIn handler);

    // What answers when a command of the host is typed with `--json` as its last argument, which is taken
    // away.
    void addListing(std::wstring_view name, BuiltIn handler);

    // A command of an application that is not loaded yet. It is listed until the application registers one of
    // that name, and again when that has gone.
    void announce(const Description& description);

    // The command belongs to the application that is being called.
    int addCommand(const wchar_t* group, const wchar_t* globalName, const wchar_t* localName, int flags,
                   TsEdCommandHandler handler, TsEdUIContext* uiContext, int functionCode, void* resources,
                   TsEdCommand** command) override;
    int removeCommand(const wchar_t* group, const wchar_t* globalName) override;
    int removeGroup(const wchar_t* group) override;

    // As `tsedDescribeCommand`.
    int describe(const wchar_t* group, const wchar_t* globalName, std::wstring_view description);
    // As `tsedTakeArguments`.
    int takeArguments(const wchar_t* group, const wchar_t* globalName, std::wstring_view usage);

    // As `tsedOfferEntries`.
    int offerEntries(const wchar_t* group, const wchar_t* globalName, TsEdEntries entries);

    // The command that a person types so, or null. Where several share a name, it is the one that was
    // registered first, so that nobody can take the host's own away.
    Command find(std::wstring_view typedName) const;

    // The same command, or one that is announced, as a person is told of it.
    std::optional<Description> description(std::wstring_view typedName) const;

    // The commands that the application at that path has registered, in the order of registration.
    std::vector<Names> commandsOf(const std::wstring& applicationPath) const;

    // An application that is unloaded takes its commands along.
    void removeCommandsOf(const std::wstring& applicationPath);

    // What a person may type, sorted, in the spelling of registration.
    std::vector<std::wstring> names() const;

    // Every command, group by group, groups in the order in which they were made.
    std::vector<Description> descriptions() const;

private:
    TsEdCommand* applications(const wchar_t* group, const wchar_t* globalName) const;
    int setLine(const wchar_t* group, const wchar_t* globalName, std::wstring TsEdCommand::*line,
                std::wstring_view text);
    std::size_t removeIf(const std::function<bool(const TsEdCommand&)>& goes);

    const CallingApplication& mCalls;
    std::vector<std::shared_ptr<TsEdCommand>> mCommands;
    std::vector<Description> mAnnounced;
};
} // namespace tessel
