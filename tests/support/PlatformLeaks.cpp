// What the platform's own libraries never give back, for the leak check of the sanitized build: Objective-C
// classes and the platform's singletons live as long as the process.
extern "C" __attribute__((visibility("default"))) const char* __lsan_default_suppressions()
{
    return "leak:libobjc\nleak:libgnustep\n";
}
