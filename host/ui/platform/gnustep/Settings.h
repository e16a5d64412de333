// The settings of the toolkit: its user defaults.
#pragma once

#import <Foundation/Foundation.h>

namespace tessel::windowing
{
// Settings that hold where the person has chosen nothing else, for this program or for all of the toolkit's.
void suggestSettings(NSDictionary* settings);
} // namespace tessel::windowing
