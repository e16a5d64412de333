// A host of its own for each test.
#pragma once

#include <gmock/gmock.h>

#include "tests/contract/HostUnderTest.h"

// Room for a path, as the calls want it.
inline constexpr std::size_t kPathSize = 1024;

class ContractTest : public testing::Test
{
protected:
    std::unique_ptr<HostUnderTest> host = startHost();
};

inline bool contains(const std::wstring& text, const std::wstring& part)
{
    return text.find(part) != std::wstring::npos;
}
