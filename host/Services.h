// The parts of the running host, as the SDK's free functions and the parts themselves find one another.
//
// `Host` (host/app) makes the parts in an order, stores them here and takes them out again when it ends. A
// null pointer says that the part is not running; only code that can run outside of a session needs to ask.
#pragma once

namespace tessel
{
class ApplicationServices; // host/app: TsDbHostApplicationServices
class CallingApplication;  // host/commands: whose entry point or command is running
class CommandLine;         // host/text: where the host's text goes
class CommandStack;        // host/commands
class Document;            // host/applications
class DynamicLinker;       // host/applications
class EndRequest;          // host/commands: whether the session is to end
class FileSearch;          // host/files
class Help;                // host/messages
class LispInterpreter;     // host/lisp
class MessageBox;          // host/messages
class Registry;            // host/registry
class RemoteFiles;         // host/files
class ResourceModules;     // host/resources
class SystemVariables;     // host/registry

struct Services
{
    CommandLine* commandLine = nullptr;
    EndRequest* endRequest = nullptr;
    Registry* registry = nullptr;
    SystemVariables* variables = nullptr;
    CallingApplication* callingApplication = nullptr;
    ResourceModules* resources = nullptr;
    CommandStack* commands = nullptr;
    DynamicLinker* linker = nullptr;
    Document* document = nullptr;
    LispInterpreter* lisp = nullptr;
    FileSearch* files = nullptr;
    RemoteFiles* remote = nullptr;
    ApplicationServices* application = nullptr;
    MessageBox* messageBox = nullptr;
    Help* help = nullptr;
    bool removingTsLisp = true; // a setting of the host, read once before any application is loaded
};

Services& services();
} // namespace tessel
