// The toolkit starts programs of its own when it first needs them: one that carries the pasteboard, one that
// carries notifications. They make daemons of themselves, serve all programs of their user and outlive the
// session that started them. Here they stay its children and end with it, whatever ends it, and therefore
// serve it alone: the windows of another would lose them in the middle of a question. They and those that
// they serve find one another by the folder for temporary files; with other programs they talk by way of the
// display.
#import <Foundation/Foundation.h>
#import <GNUstepBase/NSObject+GNUstepBase.h>

#include <csignal>
#include <cstdlib>
#include <string>
#include <vector>

#include <fcntl.h>
#include <sys/prctl.h>
#include <unistd.h>

#include <tesselui/tsuieach.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/platform/gnustep/ToolkitProcess.h"
#include "host/ui/platform/gnustep/Behaviour.h"
#include "host/ui/platform/gnustep/SessionFolder.h"

namespace tessel::windowing
{
namespace
{
using LaunchTask = void (*)(id, SEL);
LaunchTask toolkitLaunchTask;
SessionFolder* gFolder;

bool isHelper(NSString* path)
{
    NSString* program = [path lastPathComponent];
    return [program isEqual:@"gpbs"] || [program isEqual:@"gdnc"];
}

// Not as a daemon: they fork unless told otherwise.
std::vector<std::string> commandLine(NSString* path, NSArray* arguments)
{
    std::vector<std::string> command = {[path fileSystemRepresentation], "--no-fork"};
    for (NSString* argument : tsuiEach<NSString*>(arguments))
        if (![argument isEqual:@"--daemon"])
            command.emplace_back([argument UTF8String]);
    return command;
}

// The folder for temporary files of the toolkit and of its helpers; other programs that are started keep the
// person's own.
constexpr char kTemporaryFolder[] = "TEMP";

// Where the toolkit would put them: the names of its ports are as long as may be, and no longer.
std::string temporaryFiles()
{
    for (const char* variable : {kTemporaryFolder, "TMP"})
        if (const char* folder = std::getenv(variable))
            return folder;
    return "/tmp";
}

std::string sessionFolder()
{
    return gFolder->path().empty() ? temporaryFiles() : gFolder->path().string();
}

NSDictionary* personalEnvironment(NSDictionary* environment)
{
    NSMutableDictionary* result = [[environment mutableCopy] autorelease];
    NSString* name = [NSString stringWithUTF8String:kTemporaryFolder];
    [result removeObjectForKey:name];
    if (const char* personal = std::getenv(kTemporaryFolder))
        [result setObject:[NSString stringWithUTF8String:personal] forKey:name];
    return result;
}

std::vector<const char*> pointersTo(const std::vector<std::string>& texts)
{
    std::vector<const char*> pointers;
    pointers.reserve(texts.size() + 1);
    for (const std::string& text : texts)
        pointers.push_back(text.c_str());
    pointers.push_back(nullptr);
    return pointers;
}

// In the child: only what may be done there before another program is in its place.
[[noreturn]] void becomeHelper(const char* const* command, const char* const* environment, pid_t session)
{
    prctl(PR_SET_PDEATHSIG, SIGTERM);
    if (getppid() != session)
        _exit(EXIT_FAILURE); // the session ended meanwhile
    setsid();                // Ctrl-C at the prompt is not for it
    const int nothing = open("/dev/null", O_RDWR);
    for (const int descriptor : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO})
        dup2(nothing, descriptor);
    execve(command[0], const_cast<char* const*>(command), const_cast<char* const*>(environment));
    _exit(EXIT_FAILURE);
}

// By fork: spawning a program gives no occasion to ask for a signal when its parent ends.
void startHelper(const std::vector<std::string>& command)
{
    const auto variables = environmentWith(kTemporaryFolder, sessionFolder());
    const auto words = pointersTo(command);
    const auto environment = pointersTo(variables);
    const pid_t session = getpid();
    if (fork() == 0)
        becomeHelper(words.data(), environment.data(), session);
}

// The toolkit does not look at the task again when it is one of these.
void launchTask(id task, SEL selector)
{
    if (isHelper([task launchPath]))
        return startHelper(commandLine([task launchPath], [task arguments]));
    [task setEnvironment:personalEnvironment([task environment])];
    toolkitLaunchTask(task, selector);
}
} // namespace

} // namespace tessel::windowing

// When the process exits the toolkit puts its things away, the latest first, and fails where their folder is
// gone: it is to go among them, in its turn.
@interface TsSessionFolderEnd : NSObject
+ (void)atExit;
@end

@implementation TsSessionFolderEnd
+ (void)atExit
{
    delete tessel::windowing::gFolder;
}
@end

namespace tessel::windowing
{
void keepHelperProgramsToTheSession()
{
    gFolder = new SessionFolder(temporaryFiles());
    [TsSessionFolderEnd registerAtExit];
    tellToolkitOfProcess(environmentWith(kTemporaryFolder, sessionFolder()));
    toolkitLaunchTask = standInFor("NSConcreteUnixTask", @selector(launch), launchTask);
}
} // namespace tessel::windowing
