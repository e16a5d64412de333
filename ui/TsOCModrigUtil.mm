#import "ui/TsOCModrigUtil.h"

@implementation TsOCModrigUtil

+ (NSString*)modrigLoadString:(NSString*)key
{
    NSBundle* bundle = [NSBundle bundleForClass:[TsOCModrigUtil class]];
    return [bundle localizedStringForKey:key value:@"" table:nil];
}

@end
