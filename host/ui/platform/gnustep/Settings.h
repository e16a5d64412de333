// The settings of the toolkit, its user defaults, and its log.
#pragma once

#import <Foundation/Foundation.h>

namespace tessel::windowing
{
// Before anything asks for a setting.
void keepSettingsIn(NSString* folder);

// From now on what the toolkit has to say goes into a file of that folder, which is made when it says
// something.
void keepComplaintsIn(NSString* folder);

// Settings that hold where the person has chosen nothing else, for this program or for all of the toolkit's.
void suggestSettings(NSDictionary* settings);

// A setting of this session that holds whatever the person has chosen, but for what the program was started
// with.
void insistOnSetting(NSString* name, NSString* value);
} // namespace tessel::windowing
