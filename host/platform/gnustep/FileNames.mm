// Names that are no text have no string here, and strings with the host's characters for their bytes lead to
// no file. Whatever turns the one into the other goes through two methods of the file manager.
#import <Foundation/Foundation.h>

#include <wincompat/winstring.h>

#include <string>

#include "host/platform/FileNames.h"
#include "host/platform/gnustep/StandIn.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
using BytesOf = const char* (*)(id, SEL, NSString*);
using StringOf = NSString* (*)(id, SEL, const char*, NSUInteger);
BytesOf toolkitBytesOf;
StringOf toolkitStringOf;

bool hasBytes(const std::wstring& text)
{
    return withReadableBytes(text) != text;
}

const char* bytesOf(id manager, SEL selector, NSString* path)
{
    const std::wstring text = NSStringToWstring(path);
    if (!hasBytes(text))
        return toolkitBytesOf(manager, selector, path);
    const std::string bytes = toUtf8(text);
    return static_cast<const char*>([[NSData dataWithBytes:bytes.c_str() length:bytes.size() + 1] bytes]);
}

NSString* stringOf(id manager, SEL selector, const char* bytes, NSUInteger length)
{
    const std::wstring text = bytes ? toWide({bytes, length}) : std::wstring();
    if (!hasBytes(text))
        return toolkitStringOf(manager, selector, bytes, length);
    return wcharToNSString(text.c_str());
}
} // namespace

void nameEveryFile()
{
    if (toolkitBytesOf)
        return;
    constexpr char kManager[] = "NSFileManager";
    toolkitBytesOf = standInFor(kManager, @selector(fileSystemRepresentationWithPath:), bytesOf);
    toolkitStringOf = standInFor(kManager, @selector(stringWithFileSystemRepresentation:length:), stringOf);
}
} // namespace tessel
