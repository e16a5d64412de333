// The ids of the texts in the resource module ModrigRes.dll. The comment after each says what its one
// placeholder stands for, if it has one.
#pragma once

namespace ModrigMessages
{
inline constexpr unsigned kOpenPanelTitle = 1;
inline constexpr unsigned kCannotLoadFile = 2; // full path
inline constexpr unsigned kModuleLocked = 3;   // file name

// What was done to how many applications: the first names the only one, the second counts.
inline constexpr unsigned kOneLoaded = 8;                // file name
inline constexpr unsigned kManyLoaded = 9;               // count
inline constexpr unsigned kOneAddedToStartupSuite = 10;  // file name
inline constexpr unsigned kManyAddedToStartupSuite = 11; // count
inline constexpr unsigned kOneUnloaded = 12;             // file name
inline constexpr unsigned kManyUnloaded = 13;            // count
inline constexpr unsigned kOneRemovedFromHistory = 35;   // file name
inline constexpr unsigned kManyRemovedFromHistory = 36;  // count

inline constexpr unsigned kStartupSuitePanelTitle = 14;
inline constexpr unsigned kLispPrompt = 15;

inline constexpr unsigned kCommandGroup = 16;
inline constexpr unsigned kCommandGlobalName = 17;
inline constexpr unsigned kCommandLocalName = 18;

inline constexpr unsigned kListNotStored = 19;
inline constexpr unsigned kFilterNotStored = 24;

// File-type filters: a description, "|" and patterns separated by ";".
inline constexpr unsigned kAllApplicationsFilter = 25; // an integer and the host's product name
inline constexpr unsigned kBundleFilter = 26;
inline constexpr unsigned kCoreModuleFilter = 51;
inline constexpr unsigned kLispSourceFilter = 27;
inline constexpr unsigned kObjectModuleFilter = 28;
inline constexpr unsigned kCompiledLispFilter = 29;
inline constexpr unsigned kPackagedLispFilter = 46;
inline constexpr unsigned kMacroProjectFilter = 47;

inline constexpr unsigned kTooManyFiles = 37; // the limit
inline constexpr unsigned kLoadFailed = 38;   // full path
inline constexpr unsigned kUrlNotFetched = 39;
inline constexpr unsigned kTemporaryInternetFile = 41; // full path
inline constexpr unsigned kAlreadyLoaded = 48;         // file name

inline constexpr unsigned kDialogFailed = 60; // the toolkit's own words
} // namespace ModrigMessages
