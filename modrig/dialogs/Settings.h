// What the Load/Unload dialog remembers in the host's store of dialog settings.
#pragma once

#import <Foundation/NSString.h>

static NSString* const kSettingsGroup = @"Modrig";
static NSString* const kSaveHistorySetting = @"SaveHistory"; // the check box
static NSString* const kLastTabSetting = @"LastTab";
static NSString* const kWindowSetting = @"Window";
static NSString* const kLoadedColumnSetting = @"LoadedColumn"; // widths of the tables' first columns
static NSString* const kHistoryColumnSetting = @"HistoryColumn";
static NSString* const kSuiteWindowSetting = @"StartupSuiteWindow";
static NSString* const kSuiteColumnSetting = @"StartupSuiteColumn";
static NSString* const kInitialPathSetting = @"InitialPath"; // the folder that the panel opens in
