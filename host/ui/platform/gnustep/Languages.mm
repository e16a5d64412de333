#include "host/ui/platform/gnustep/Languages.h"

#import <Foundation/Foundation.h>

#include "host/text/Languages.h"

namespace
{
// Where the toolkit keeps what it has found out about the system, the languages too. It is read before all
// others.
NSString* const kFoundByTheToolkit = @"GSPrimaryDomain";
} // namespace

void tessel::windowing::takePersonsLanguages()
{
    NSMutableArray* languages = [NSMutableArray array];
    for (const std::string& language : personsLanguages())
        [languages addObject:[NSString stringWithUTF8String:language.c_str()]];
    [languages addObject:@"en"]; // for what they lack
    NSUserDefaults* defaults = [NSUserDefaults standardUserDefaults];
    NSMutableDictionary* settings = [NSMutableDictionary dictionary];
    [settings addEntriesFromDictionary:[defaults volatileDomainForName:kFoundByTheToolkit]];
    [settings setObject:languages forKey:@"NSLanguages"];
    [defaults removeVolatileDomainForName:kFoundByTheToolkit]; // one that is there cannot be set
    [defaults setVolatileDomain:settings forName:kFoundByTheToolkit];
}
