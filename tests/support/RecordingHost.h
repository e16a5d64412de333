// A host for unit tests: the whole SDK in memory. It answers as told and remembers what it was asked.
//
//     class MyTest : public testing::Test
//     {
//     protected:
//         void SetUp() override { recordingHost().reset(); }
//     };
//
//     TEST_F(MyTest, SaysWhichModuleIsLocked)
//     {
//         recordingHost().linker.setLocked(L"/a/tool.zmb");
//         ...
//         EXPECT_THAT(recordingHost().output.lines(), ElementsAre(L"..."));
//     }
//
// A program links `recording_host` and one of `recording_host_removing` and `recording_host_not_removing`
// (what `RemovingTsLISP` answers during static initialisation); with the module's logic also
// `recording_dialog` (see RecordingDialog.h).
//
// Whatever the SDK has the caller give back is watched: a test that ends before it has been given back fails.
//
// Untold, the host behaves like a real one that has just been started: every application loads, there is one
// profile, one empty document, no file, no variable, no resource module. Each part below says in its own
// header what can be told and what is remembered.
#pragma once

#include "tests/support/recording/Journal.h"
#include "tests/support/recording/RecordingApplicationRecords.h"
#include "tests/support/recording/RecordingApplicationServices.h"
#include "tests/support/recording/RecordingCommands.h"
#include "tests/support/recording/RecordingDocument.h"
#include "tests/support/recording/RecordingFiles.h"
#include "tests/support/recording/RecordingLinker.h"
#include "tests/support/recording/RecordingLisp.h"
#include "tests/support/recording/RecordingLoadedModules.h"
#include "tests/support/recording/RecordingOutput.h"
#include "tests/support/recording/RecordingQuestions.h"
#include "tests/support/recording/RecordingRegistry.h"
#include "tests/support/recording/RecordingResources.h"
#include "tests/support/recording/RecordingServices.h"
#include "tests/support/recording/RecordingSession.h"
#include "tests/support/recording/RecordingVariables.h"

class RecordingHost
{
public:
    RecordingHost();

    // Forgets everything that was told and remembered. Handles and pointers of the time before are invalid.
    void reset();

    // The current profile is the unnamed value of the product's key "Profiles". After `reset` it is called
    // "Default"; an empty name takes it away.
    void setProfile(const std::wstring& name);
    // Where that profile's Modrig settings are kept; the key need not exist.
    std::wstring moduleKey() const;

    Journal journal; // every call, in order

    RecordingServices services;                       // tsrxSysRegistry
    RecordingSession session;                         // tsrxEndRequest, tsrxBeforeWaiting
    RecordingLinker linker;                           // "DynamicLinker"
    RecordingLoadedModules loadedModules;             // tsedQmbLoaded, tsedGetModuleFileName, tsedGetAppName
    RecordingCommands commands;                       // "TESSEL_REGISTERED_COMMANDS"
    RecordingApplicationRecords applicationRecords;   // TesselAppInfo
    RecordingApplicationServices applicationServices; // tsdbHostApplicationServices
    RecordingInternet internet;                       // CProxyInet
    RecordingRegistry registry;                       // Reg..., tsRegGetValue, tsudRegSetString
    RecordingResources resources;                     // LoadLibrary, FreeLibrary, Afx..., loadStringFrom...
    RecordingFiles files;                             // attributes, current folder, tsedFindFile
    RecordingVariables variables;                     // tsedGetVar
    RecordingLisp lisp;                               // qxr_queueexpr, tsedInvoke, RemovingTsLISP
    RecordingDocument document;                       // curDoc
    RecordingOutput output;                           // tsutPrintf, VqHostMessageBox, tsedHelp
    RecordingQuestions questions;                     // tsask...

private:
    std::wstring mProfile;
};

// The one host of the process, ready from the first call on, also during static initialisation.
RecordingHost& recordingHost();

// While it lives, the application at the path is the one that is being called.
class RecordingCaller
{
public:
    explicit RecordingCaller(std::wstring path);
    ~RecordingCaller();
    RecordingCaller(const RecordingCaller&) = delete;
    RecordingCaller& operator=(const RecordingCaller&) = delete;

private:
    std::wstring mPrevious;
};

// Copies the text with its terminator; false, and nothing is touched, when it does not fit.
bool copyText(const std::wstring& text, wchar_t* buffer, std::size_t capacity);
