// The texts of a bundle, by keys.
#pragma once

#import <Foundation/Foundation.h>

// The text of the key in the person's language, in English where that has none, the key itself where there is
// none either. `table`: the name of the file with the texts; nil: Localizable.strings.
inline NSString* tsuiTextOf(NSBundle* bundle, NSString* key, NSString* table)
{
    NSString* text = [bundle localizedStringForKey:key value:@"" table:table];
    if ([text length] && ![text isEqual:key])
        return text;
    NSString* file = [bundle pathForResource:table ? table : @"Localizable"
                                      ofType:@"strings"
                                 inDirectory:nil
                             forLocalization:@"en"];
    NSString* content =
        file ? [NSString stringWithContentsOfFile:file encoding:NSUTF8StringEncoding error:nullptr] : @"";
    text = [[content propertyListFromStringsFileFormat] objectForKey:key];
    return text ? text : key;
}
