// A host with the parts that loading needs, its output in a text, and a throwaway folder for modules.
#pragma once

#include <filesystem>
#include <string>

#include <gtest/gtest.h>

#include "host/applications/Admission.h"
#include "host/applications/Bisecting.h"
#include "host/applications/DynamicLinker.h"
#include "host/applications/KeptOut.h"
#include "host/applications/LoadOutcomes.h"
#include "host/commands/CallingApplication.h"
#include "host/commands/CommandRunner.h"
#include "host/commands/CommandStack.h"
#include "host/messages/MessageBox.h"
#include "host/resources/ResourceModules.h"
#include "host/text/CommandLine.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"
#include "tests/support/TemporaryFolder.h"

class HostWithModules : public testing::Test
{
public:
    HostWithModules() = default;
    ~HostWithModules() override;
    HostWithModules(const HostWithModules&) = delete;
    HostWithModules& operator=(const HostWithModules&) = delete;

protected:
    // A copy of a fixture module in the throwaway folder, so that no other test has mapped it.
    std::filesystem::path fixture(const std::string& name) const;
    std::filesystem::path fixture(const std::string& name, const std::filesystem::path& copy) const;

    bool load(const std::filesystem::path& path);
    bool unload(const std::filesystem::path& path);
    std::wstring names() const; // of the loaded modules, each with a blank after it

    // What was printed since the last call.
    std::string output();

    static bool isMapped(const std::filesystem::path& path);
    // The sentence for a module that is not loaded.
    static std::string notLoaded(const std::filesystem::path& path, const std::string& whyNot);
    static std::string notUnloaded(const std::filesystem::path& path, const std::string& whyNot);

    TemporaryFolder mFolder;

private:
    std::string mOutput;

protected:
    tessel::CommandLine mCommandLine{[this](std::string_view piece)
                                     {
                                         mOutput += piece;
                                     }};
    tessel::RunningMarker mMarker;
    tessel::KeptOut mKeptOut;
    tessel::Bisecting mBisecting;
    tessel::Admission mAdmission{mCommandLine, mMarker, mKeptOut, mBisecting, false};
    tessel::CallingApplication mCalls{mMarker};
    tessel::CommandStack mCommands{mCalls};
    tessel::CommandRunner mRunner{mCommands, mCommandLine, mCalls};
    tessel::MessageBox::Presenter mShowBox; // boxes are text while there is none
    tessel::MessageBox mMessageBox{mCommandLine, [this](const tessel::MessageBox::Box& box)
                                   {
                                       return mShowBox ? mShowBox(box) : 0;
                                   }};
    tessel::LoadOutcomes mOutcomes;
    tessel::DynamicLinker mLinker{mCommandLine, mCalls, mCommands, mMessageBox, mOutcomes, mAdmission};
    tessel::ResourceModules mResources{
        tessel::toWide((mFolder / "HostResources").native()), mCalls, {"de_AT", "de"}};

private:
    tessel::Published<tessel::CommandLine> mPublishedCommandLine{mCommandLine};
    tessel::Published<tessel::CallingApplication> mPublishedCalls{mCalls};
    tessel::Published<tessel::CommandStack> mPublishedCommands{mCommands};
    tessel::Published<tessel::MessageBox> mPublishedMessageBox{mMessageBox};
    tessel::Published<tessel::DynamicLinker> mPublishedLinker{mLinker};
    tessel::Published<tessel::ResourceModules> mPublishedResources{mResources};
};
