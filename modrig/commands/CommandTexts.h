// What the commands say beside the module's own messages, by id: texts of ModrigLists.rc. The comment after
// each says what its placeholders stand for.
#pragma once

namespace ModrigMessages
{
inline constexpr unsigned kListsGroup = 128; // of the commands
inline constexpr unsigned kSuiteUsage = 129;
inline constexpr unsigned kSuiteSummary = 130;
inline constexpr unsigned kHistoryUsage = 131;
inline constexpr unsigned kHistorySummary = 132;

inline constexpr unsigned kStartupSuiteName = 133; // as it stands within a sentence
inline constexpr unsigned kHistoryName = 134;
inline constexpr unsigned kListIsEmpty = 135;   // in the list
inline constexpr unsigned kEntryNotThere = 136; // after an entry, as the next one
inline constexpr unsigned kEntryLaidDown = 137;
inline constexpr unsigned kInStartupSuite = 138; // within a sentence about what is there
inline constexpr unsigned kInHistory = 139;

inline constexpr unsigned kFileNotThere = 144;      // full path
inline constexpr unsigned kPathTooLong = 145;       // full path
inline constexpr unsigned kNotInList = 146;         // full path, in the list
inline constexpr unsigned kNoSuchPlace = 147;       // what was typed, how many places there are
inline constexpr unsigned kOneAddedToHistory = 148; // file name
inline constexpr unsigned kManyAddedToHistory = 149;
inline constexpr unsigned kOneRemovedFromSuite = 150; // file name
inline constexpr unsigned kManyRemovedFromSuite = 151;
inline constexpr unsigned kMoved = 152;         // file name, its place
inline constexpr unsigned kPlaceIsNoFile = 153; // what was typed, in the list
inline constexpr unsigned kQuotesNeeded = 154;  // the name, which gets them
inline constexpr unsigned kNothingNamed = 155;
inline constexpr unsigned kTooManyAdded = 156; // the limit, how many there were, name of the list
inline constexpr unsigned kFileIsFolder = 157; // full path, as the next two
inline constexpr unsigned kFileIsNotOrdinary = 158;
inline constexpr unsigned kBundleIsFile = 159;

inline constexpr unsigned kLaidDown = 160;         // name of the list, file
inline constexpr unsigned kOtherSessionRuns = 161; // name of the list
inline constexpr unsigned kModrigStays = 162;      // name of the list
inline constexpr unsigned kModrigIsOut = 163;
inline constexpr unsigned kListNotRead = 164; // in the list, the host's sentences
} // namespace ModrigMessages
