// The toolkit starts programs of its own when it first needs them: one that carries the pasteboard, one that
// carries notifications. They make daemons of themselves and outlive the session that started them. Here they
// stay its children and end with it, whatever ends it. Those that run already serve as before.
#import <Foundation/Foundation.h>

#include <csignal>
#include <string>
#include <vector>

#include <fcntl.h>
#include <sys/prctl.h>
#include <unistd.h>

#include <tesselui/tsuieach.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"

namespace tessel::windowing
{
namespace
{
using LaunchTask = void (*)(id, SEL);
LaunchTask toolkitLaunchTask;

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

// In the child: only what may be done there before another program is in its place.
[[noreturn]] void becomeHelper(const char* const* command, pid_t session)
{
    prctl(PR_SET_PDEATHSIG, SIGTERM);
    if (getppid() != session)
        _exit(EXIT_FAILURE); // the session ended meanwhile
    setsid();                // Ctrl-C at the prompt is not for it
    const int nothing = open("/dev/null", O_RDWR);
    for (const int descriptor : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO})
        dup2(nothing, descriptor);
    execv(command[0], const_cast<char* const*>(command));
    _exit(EXIT_FAILURE);
}

void startHelper(const std::vector<std::string>& command)
{
    std::vector<const char*> pointers;
    pointers.reserve(command.size() + 1);
    for (const std::string& word : command)
        pointers.push_back(word.c_str());
    pointers.push_back(nullptr);
    const pid_t session = getpid();
    if (fork() == 0)
        becomeHelper(pointers.data(), session);
}

// The toolkit does not look at the task again when it is one of these.
void launchTask(id task, SEL selector)
{
    if (isHelper([task launchPath]))
        startHelper(commandLine([task launchPath], [task arguments]));
    else
        toolkitLaunchTask(task, selector);
}
} // namespace

void endHelperProgramsWithTheSession()
{
    toolkitLaunchTask = standInFor("NSConcreteUnixTask", @selector(launch), launchTask);
}
} // namespace tessel::windowing
