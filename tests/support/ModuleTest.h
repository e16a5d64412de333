// What the tests of the module's logic share: a host that has just been started, the module's lists empty,
// and texts that show their id.
#pragma once

#include <initializer_list>
#include <string>
#include <vector>

#include <gmock/gmock.h>

#include "modrig/base/CStringList.h"
#include "tests/support/RecordingDialog.h"
#include "tests/support/RecordingHost.h"

class ModuleTest : public testing::Test
{
protected:
    void SetUp() override;
    // Ends the module as far as a test has started it: the texts are what it keeps between two calls.
    void TearDown() override;

    static RecordingHost& host() { return recordingHost(); }
    static std::vector<std::wstring> boxes() { return host().output.boxTexts(); }
    static std::vector<std::wstring> lines() { return host().output.lines(); }
};

inline constexpr const wchar_t* kResourceModuleName = L"ModrigRes.dll";

// Text `id` of the tests: "[id] %s", with the argument in place of the conversion.
std::wstring Message(unsigned id, const std::wstring& argument);

std::vector<std::wstring> Texts(const CStringList& list);
void Fill(CStringList& list, std::initializer_list<const wchar_t*> texts);

// A path of exactly `length` characters, of folders that a file system would take, that ends with the tail.
std::wstring LongPath(std::size_t length, const std::wstring& tail);

// The entries that are no bookkeeping of the registry, the variables and the current resource module.
std::vector<std::wstring> WithoutBookkeeping(const std::vector<std::wstring>& journal);
