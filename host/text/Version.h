#pragma once

#include <string>

namespace tessel
{
inline constexpr char kProgramName[] = "Tessel R21";
inline constexpr char kProgramLine[] = "Tessel R21, reference host for Modrig";

// The registry key below which the host and its applications keep what they store.
inline constexpr wchar_t kProductRegistryRoot[] = L"Software\\Tessel\\R21";

// Of the program, the compiler and Modrig, which are released together: "1.0.0". CMake's project has it.
std::string version();

// What was asked for its version says, and which it is.
std::string versionLine(const std::string& program = kProgramLine);

// The same and its beginning as a person is told in a session.
std::wstring programSentence();
std::wstring versionSentence();
} // namespace tessel
