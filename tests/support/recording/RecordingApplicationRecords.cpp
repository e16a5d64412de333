#include "tests/support/recording/RecordingApplicationRecords.h"

#include "host/text/Unicode.h"
#include "tests/support/RecordingHost.h"
#include "tests/support/recording/RecordingLoans.h"

struct TesselAppInfo::Record : RecordingApplicationRecord
{
};

void RecordingApplicationRecords::set(const RecordingApplicationRecord& record)
{
    mRecords[tessel::foldCase(record.name)] = record;
}

std::optional<RecordingApplicationRecord> RecordingApplicationRecords::find(const std::wstring& name) const
{
    const auto found = mRecords.find(tessel::foldCase(name));
    return found == mRecords.end() ? std::nullopt : std::optional(found->second);
}

TesselAppInfo::TesselAppInfo() : mRecord(std::make_unique<Record>())
{
    recording_loans::lend(this, "application record");
}

TesselAppInfo::~TesselAppInfo()
{
    recording_loans::takeBack(this);
}

void TesselAppInfo::setAppName(const wchar_t* name)
{
    mRecord->name = orEmpty(name);
}

void TesselAppInfo::setModuleName(const wchar_t* path)
{
    mRecord->moduleName = orEmpty(path);
}

void TesselAppInfo::setDescription(const wchar_t* description)
{
    mRecord->description = orEmpty(description);
}

void TesselAppInfo::setLoadReason(unsigned reasons)
{
    mRecord->loadReason = reasons;
}

const wchar_t* TesselAppInfo::appName() const
{
    return mRecord->name.c_str();
}

const wchar_t* TesselAppInfo::moduleName() const
{
    return mRecord->moduleName.c_str();
}

const wchar_t* TesselAppInfo::description() const
{
    return mRecord->description.c_str();
}

unsigned TesselAppInfo::loadReason() const
{
    return mRecord->loadReason;
}

int TesselAppInfo::readFromRegistry()
{
    RecordingHost& host = recordingHost();
    RecordingApplicationRecords& records = host.applicationRecords;
    host.journal.add(L"readFromRegistry", {mRecord->name});
    records.reads.push_back(mRecord->name);
    if (records.answerToRead)
        return *records.answerToRead;
    if (mRecord->name.empty())
        return TSRX_APPINFO_ERROR;
    const auto stored = records.find(mRecord->name);
    if (!stored)
        return TSRX_APPINFO_NOT_FOUND;
    const std::wstring name = mRecord->name;
    static_cast<RecordingApplicationRecord&>(*mRecord) = *stored;
    mRecord->name = name;
    return TSRX_APPINFO_OK;
}

int TesselAppInfo::writeToRegistry(bool forAllUsers, bool withCommands)
{
    RecordingHost& host = recordingHost();
    RecordingApplicationRecords& records = host.applicationRecords;
    host.journal.add(L"writeToRegistry", {mRecord->name, mRecord->loadReason, forAllUsers, withCommands});
    const int status = records.answerToWrite   ? *records.answerToWrite
                       : mRecord->name.empty() ? TSRX_APPINFO_ERROR
                                               : TSRX_APPINFO_OK;
    records.writes.push_back({*mRecord, forAllUsers, withCommands, status});
    if (!records.answerToWrite && status == TSRX_APPINFO_OK)
        records.set(*mRecord);
    return status;
}
