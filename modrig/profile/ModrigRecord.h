// The record by which the host knows when to load Modrig.
#pragma once

class TesselAppInfo;

namespace ModrigUtils
{
inline constexpr const wchar_t* kRecordName = L"TesselModrig";

// Only this one reason is Modrig's to manage: name, description and the other reasons may have been changed
// by the host or by its user. Answers whether the record, which is not written here, is another one now.
[[nodiscard]] bool SetLoadedAtStart(TesselAppInfo& record, bool loadedAtStart);
} // namespace ModrigUtils
