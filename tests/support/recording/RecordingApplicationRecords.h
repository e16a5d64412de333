// The host's records of applications: what `TesselAppInfo` reads and writes.
#pragma once

#include <map>
#include <optional>
#include <string>
#include <vector>

#include <tessel/tsappinfo.h>

// One stored record.
struct RecordingApplicationRecord
{
    std::wstring name;
    std::wstring moduleName;
    std::wstring description;
    unsigned loadReason = 0;

    bool operator==(const RecordingApplicationRecord&) const = default;
};

class RecordingApplicationRecords
{
public:
    struct Write
    {
        RecordingApplicationRecord record;
        bool forAllUsers = false;
        bool withCommands = false;
        int status = TSRX_APPINFO_OK;
    };

    void set(const RecordingApplicationRecord& record);
    std::optional<RecordingApplicationRecord> find(const std::wstring& name) const; // any case

    // The names read and the records written, in order, whatever came of it.
    std::vector<std::wstring> reads;
    std::vector<Write> writes;

    // When set, every read (write) answers this and does nothing else.
    std::optional<int> answerToRead;
    std::optional<int> answerToWrite;

private:
    std::map<std::wstring, RecordingApplicationRecord> mRecords; // by folded name
};
