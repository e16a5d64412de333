// The applications that the tests of Modrig in the real host load, and what the host says about them.
#pragma once

#include <string>
#include <vector>

#include "tests/e2e/HostProcess.h"

inline constexpr char kBanner[] =
    "Tessel R21, reference host for Modrig. Type HELP for the list of commands, QUIT to leave.\n";

// What loading a Lisp file by way of Modrig ends with, when a line follows.
inline constexpr char kLispReady[] = "\nReady. \n";

inline constexpr char kSuiteKey[] = R"(Software\Tessel\R21\Profiles\Default\Dialogs\Modrig\Startup)";
inline constexpr char kRecordKey[] = R"(Software\Tessel\R21\Applications\TesselModrig)";

using Paths = std::vector<std::string>;

// What the sample of primes says when it is loaded.
inline constexpr char kPrimes[] = "Primes: type PRIMES to see them on a spiral.\n";

std::string sample(const std::string& name);
std::string fixtureModule(const std::string& name);
// An application in the session's folder that ends the host in that way (see fixtures/modules/Deadly.cpp).
std::string deadly(const HostSession& session, const std::string& way);
// A form that ends the host by a memory fault. Any thread may take the signal: the one that runs Lisp waits
// for the end.
inline constexpr char kLispThatFaults[] = "(progn (ext:system \"kill -SEGV $PPID\") (sleep 60))";
std::string lispFixture(const std::string& name);
std::string modrigBundle();

// An argument of a command, in quotes.
std::string inQuotes(const std::string& text);

// A command that puts a value into the stored Startup Suite.
std::string setInSuite(const std::string& name, const std::string& data);
// Stores the Startup Suite, in a session that loads nothing.
void storeSuite(const HostSession& session, const Paths& paths);
// The text of a registry file with a Startup Suite.
std::string suiteInFile(const Paths& paths);
// Lays out a Suite of one application for everybody; `place`: below the session's folder `layout`.
void layOutSuite(const HostSession& session, const std::string& place, const std::string& application);
// Makes the host leave Modrig alone until somebody asks for it. Otherwise nothing can be done before it is
// loaded.
void putOffModrig(const HostSession& session);
// The arguments that run the commands one after the other.
std::vector<std::string> byArguments(const std::vector<std::string>& commands);

// The line of APPS about an application. The state: kMayBeUnloaded, "locked", "Lisp".
inline constexpr char kMayBeUnloaded[] = "may be unloaded";
std::string listed(const std::string& path, const std::string& state = kMayBeUnloaded);

// What is said about a file that is not loaded: by the linker, and by Modrig.
std::string linkerRefuses(const std::string& path, const std::string& reason);
std::string modrigDoesNotKnow(const std::string& path);
std::string modrigDoesNotLoad(const std::string& path);

// What the boxes about a file say of which Modrig does not know the type.
std::string notOfAType(const std::string& path);

// A file that was not loaded, and why.
using NotLoaded = std::pair<std::string, std::string>;

// What APPS says of them at its end.
std::string listedAsNotLoaded(const std::vector<NotLoaded>& files);

// What the host says when a start is over in which files were not loaded: each with its reason, to the stop.
std::string startSummary(const std::vector<NotLoaded>& files);
