// The host's records of applications: what is called what, where it is and when it is loaded.
#pragma once

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
class CallingApplication;
class CommandStack;
class LayeredRegistry;

struct ApplicationRecord
{
    std::wstring name;
    std::wstring module; // full path
    std::wstring description;
    unsigned loadReasons = 0;
    std::wstring toldGone; // the module when the person was told that it is not there
    std::vector<std::pair<std::wstring, std::wstring>> commands; // global and local names
};

// The sum of bits that a text stands for.
std::optional<unsigned> parseLoadReasons(const std::wstring& text);

class ApplicationRecords
{
public:
    ApplicationRecords(LayeredRegistry& registry, const CommandStack& commands,
                       const CallingApplication& calls, const std::wstring& productRoot);

    // A record that counts in this session as long as none of its name is stored.
    void add(const ApplicationRecord& record);

    // Every record, in the order in which they were made; what was added comes last.
    std::vector<ApplicationRecord> all() const;

    // The record of that name, without its commands.
    std::optional<ApplicationRecord> read(const std::wstring& name) const;

    // Stores the record in place of an earlier one of its name, all but its commands.
    Result<> write(const ApplicationRecord& record);

    // Stores what the record says of a module that is not there.
    Result<> writeToldGone(const ApplicationRecord& record);

    // Stores the commands of the application that is being called, in place of those of an earlier version.
    Result<> writeCommandsOfCaller(const std::wstring& name);

private:
    std::wstring keyOf(const std::wstring& name) const;
    std::wstring commandsKeyOf(const std::wstring& name) const;
    void readCommands(ApplicationRecord& record) const;

    LayeredRegistry& mRegistry;
    const CommandStack& mCommands;
    const CallingApplication& mCalls;
    std::wstring mKey;
    std::vector<ApplicationRecord> mAdded;
};
} // namespace tessel
