// What the Load/Unload dialog remembers in the host's store of dialog settings.
#pragma once

#import <Foundation/NSString.h>

static NSString* const kSettingsGroup = @"Modrig";
static NSString* const kSaveHistorySetting = @"SaveHistory"; // the check box
static NSString* const kLastTabSetting = @"LastTab";
static NSString* const kInitialPathSetting = @"InitialPath"; // the folder that the panel opens in
