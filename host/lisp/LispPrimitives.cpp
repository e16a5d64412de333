#include "host/lisp/LispPrimitives.h"

#include <cstddef>
#include <exception>
#include <string>
#include <thread>

#include <ecl/ecl.h>

#include "host/lisp/LispFile.h"
#include "host/lisp/LispInterrupter.h"
#include "host/lisp/LispOutput.h"
#include "host/lisp/LispValues.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
// Lisp calls plain functions, and may leave them by a jump. So everything that has a destructor lives here.
struct Connection
{
    LispSurroundings* surroundings = nullptr;
    LispInterrupter* interrupter = nullptr;
    std::thread::id thread;
    LispOutput output;
    Result<LispFile> file = LispFile();
    Result<> hostCode; // how the host's own code ended
};

Connection& connection()
{
    static Connection instance;
    return instance;
}

template <typename Work>
void runCatching(Work work) noexcept
{
    connection().hostCode = {};
    try
    {
        work();
    }
    catch (const std::exception& exception)
    {
        connection().hostCode = Failure{toWide(exception.what())};
    }
    catch (...)
    {
        connection().hostCode = Failure{translated(L"The host failed for a reason of its own.")};
    }
}

// The host's text has one writer. What a thread that the user has started prints goes nowhere.
bool isThreadOfLisp()
{
    return std::this_thread::get_id() == connection().thread;
}

// An error of Lisp is left by a jump, which no destructor takes part in.
[[noreturn]] void refuseThread()
{
    thread_local std::wstring why;
    why = translated(L"Files are loaded by Lisp's main thread only.");
    FEerror("~A", 1, toLisp(why));
}

// Runs code of the host for Lisp, which is not made for two threads at once. An interrupt waits meanwhile: it
// would jump over destructors. What the code throws becomes an error of Lisp.
template <typename Work>
void callHost(Work work)
{
    if (!isThreadOfLisp())
        refuseThread();
    const cl_env_ptr environment = ecl_process_env();
    ecl_disable_interrupts_env(environment);
    runCatching(work);
    ecl_enable_interrupts_env(environment);
    if (!connection().hostCode)
        FEerror("~A", 1, toLisp(connection().hostCode.sentence()));
}

cl_object answer(cl_object value)
{
    ecl_process_env()->nvalues = 1;
    return value;
}

cl_object writeText(cl_object text, cl_object start, cl_object end)
{
    if (ECL_STRINGP(text) && isThreadOfLisp())
        callHost(
            [=]
            {
                for (cl_fixnum index = ecl_fixnum(start); index < ecl_fixnum(end); ++index)
                    connection().output.add(
                        static_cast<wchar_t>(ecl_char(text, static_cast<cl_index>(index))));
            });
    return answer(text);
}

cl_object writeCharacter(cl_object character)
{
    if (isThreadOfLisp())
        callHost([=] { connection().output.add(static_cast<wchar_t>(ECL_CHAR_CODE(character))); });
    return answer(character);
}

cl_object flush()
{
    if (isThreadOfLisp())
        callHost([] { connection().output.flush(); });
    return answer(ECL_NIL);
}

cl_object column()
{
    std::size_t count = 0;
    if (isThreadOfLisp())
        callHost([&count] { count = connection().output.column(); });
    return answer(ecl_make_fixnum(static_cast<cl_fixnum>(count)));
}

// Nothing is put in for NIL. A sentence with other places than that is said as it stands.
std::wstring translate(cl_object english, cl_object first, cl_object second)
{
    const std::wstring sentence = fromLisp(english);
    const std::size_t things = (first == ECL_NIL ? 0U : 1U) + (second == ECL_NIL ? 0U : 1U);
    if (!hasPlacesFor(things, sentence))
        return sentence;
    if (things == 0)
        return inPersonsLanguage(sentence);
    if (things == 1)
        return translateAndFill(sentence.c_str(), {fromLisp(first)});
    return translateAndFill(sentence.c_str(), {fromLisp(first), fromLisp(second)});
}

// In any thread: what is known of languages is only read. The text outlives a jump for want of memory.
cl_object translatedText(cl_object english, cl_object first, cl_object second)
{
    thread_local std::wstring text;
    const cl_env_ptr environment = ecl_process_env();
    ecl_disable_interrupts_env(environment);
    try
    {
        text = translate(english, first, second);
    }
    catch (const std::exception&) // there is no memory for more
    {
        text.clear();
    }
    ecl_enable_interrupts_env(environment);
    return answer(toLisp(text));
}

cl_object kindOf(const Result<LispFile>& file)
{
    if (!file)
        return ecl_make_keyword(file.code() == LispFile::kMissing ? "MISSING" : "REFUSED");
    return ecl_make_keyword(file->kind == LispFile::Kind::kCompiled ? "COMPILED" : "SOURCE");
}

Result<LispFile> readFor(const LispSurroundings& surroundings, const std::wstring& path)
{
    if (surroundings.fileAsked)
        surroundings.fileAsked(path);
    auto file = readLispFile(path, surroundings.removingTsLisp, surroundings.fileBegins);
    if (!file && surroundings.fileRefused)
        surroundings.fileRefused(file.failure());
    return file;
}

// A list: the kind, and then the name for messages and the text, or for what is not there or not good one
// sentence.
cl_object readFile(cl_object path)
{
    callHost(
        [=]
        {
            if (const auto* surroundings = connection().surroundings)
                connection().file = readFor(*surroundings, fromLisp(path));
        });
    const Result<LispFile>& file = connection().file;
    cl_object kind = kindOf(file);
    cl_object answered = file ? cl_list(3, kind, toLisp(file->name), toLisp(file->text))
                              : cl_list(2, kind, toLisp(cannotLoad(fromLisp(path), file.sentence())));
    callHost([] { connection().file = LispFile(); });
    return answer(answered);
}

cl_object filesOpen()
{
    std::size_t count = 0;
    callHost(
        [&count]
        {
            const auto* surroundings = connection().surroundings;
            count = surroundings && surroundings->filesOpen ? surroundings->filesOpen() : 0;
        });
    return answer(ecl_make_fixnum(static_cast<cl_fixnum>(count)));
}

cl_object endFiles(cl_object count)
{
    callHost(
        [=]
        {
            const auto* surroundings = connection().surroundings;
            if (surroundings && surroundings->filesEnd)
                surroundings->filesEnd(static_cast<std::size_t>(ecl_fixnum(count)));
        });
    return answer(ECL_NIL);
}

cl_object recordLoaded(cl_object path)
{
    callHost(
        [=]
        {
            connection().output.flush();
            if (connection().surroundings && connection().surroundings->fileLoaded)
                connection().surroundings->fileLoaded(fromLisp(path));
        });
    return answer(ECL_NIL);
}

// The words are NIL for a file that was refused.
cl_object fileFailed(cl_object path, cl_object words)
{
    callHost(
        [=]
        {
            const auto* surroundings = connection().surroundings;
            if (surroundings && surroundings->fileFailed)
                surroundings->fileFailed(fromLisp(path), words == ECL_NIL ? std::wstring() : fromLisp(words));
        });
    return answer(ECL_NIL);
}

cl_object interruptWanted()
{
    auto* interrupter = connection().interrupter;
    return answer(interrupter && interrupter->takeRequest() ? ECL_T : ECL_NIL);
}

// By one of ECL's readers, which answers with nothing at all where the text ends before an object does.
cl_object readBy(cl_object reader, cl_object stream, cl_object subcharacter, cl_object argument)
{
    cl_object object = cl_funcall(4, reader, stream, subcharacter, argument);
    if (!object)
        FEend_of_file(stream);
    return answer(object);
}

// Half of the reserve is for the error, half for the error in its handler.
std::ptrdiff_t sizeWithoutReserve(cl_index size, int reserve)
{
    return static_cast<std::ptrdiff_t>(size) - 2 * ecl_get_option(reserve);
}

cl_object restoreStackLimits()
{
    restoreLispStackLimits();
    return answer(ECL_NIL);
}

// ECL keeps all functions as one type and calls them with the number of arguments that goes with each.
template <typename... Arguments>
void define(const char* name, cl_object (*function)(Arguments...))
{
    const auto untyped = reinterpret_cast<void (*)()>(function);
    ecl_def_c_function(_ecl_intern(name, ecl_find_package("TESSEL-HOST")),
                       reinterpret_cast<cl_objectfn_fixed>(untyped), sizeof...(Arguments));
}
} // namespace

void defineLispPrimitives()
{
    define("%TRANSLATED", translatedText);
    define("%WRITE", writeText);
    define("%WRITE-CHAR", writeCharacter);
    define("%FLUSH", flush);
    define("%COLUMN", column);
    define("%READ-FILE", readFile);
    define("%FILES-OPEN", filesOpen);
    define("%END-FILES", endFiles);
    define("%RECORD-LOADED", recordLoaded);
    define("%FILE-FAILED", fileFailed);
    define("%READ-BY", readBy);
    define("%RESTORE-STACK-LIMITS", restoreStackLimits);
    define("%INTERRUPT-WANTED", interruptWanted);
}

void connectLispPrimitives(LispSurroundings* surroundings, LispInterrupter* interrupter)
{
    connection().surroundings = surroundings;
    connection().interrupter = interrupter;
    connection().thread = std::this_thread::get_id();
    if (surroundings)
        connection().output.connect(surroundings->write, surroundings->column);
    else
        connection().output.connect({}, {});
}

// ECL lets a stack that has overflowed reach into its reserve, for the error to be handled, and must take
// that back afterwards. Its own way replaces the stack of frames by a new one while frames are being left,
// and measures the machine's stack again, by a limit that is meant for other things.
void restoreLispStackLimits()
{
    const cl_env_ptr environment = ecl_process_env();
    environment->frs_limit =
        environment->frs_org + sizeWithoutReserve(environment->frs_size, ECL_OPT_FRAME_STACK_SAFETY_AREA);
    environment->bds_limit =
        environment->bds_org + sizeWithoutReserve(environment->bds_size, ECL_OPT_BIND_STACK_SAFETY_AREA);
    environment->cs_limit =
        environment->cs_org - sizeWithoutReserve(environment->cs_size, ECL_OPT_C_STACK_SAFETY_AREA);
}

void flushLispOutput()
{
    connection().output.flush();
}
} // namespace tessel
